#pragma once

#include <string>

#include "telephony/wire/Protocol.h"
#include "telephony/wire/modem/Faults.h"
#include "telephony/wire/modem/RecordMasks.h"

namespace kelvo::modem {

/// The answers of a modem's diagnostic port, and what its readers have switched on and off.
class ModemAnswers {
public:
    explicit ModemAnswers(Faults faults);

    /// Does what a request asks for; its answer. Both are bodies of frames; a request has at least one byte.
    Bytes answer(ByteView request);

    /// As after power-on: sends nothing of its own accord. With an earlier session still going on: everything.
    void restart();
    const RecordMasks& masks() const { return _masks; }
    bool sendsEvents() const { return _events; }
    bool sendsTexts() const { return _texts; }

    static Bytes version();
    static Bytes buildId();

private:
    Bytes configure(ByteView request);
    Bytes setMask(ByteView request, ByteView data);
    std::optional<wire::Refusal> refusalOf(wire::Operation operation) const;

    const Faults _faults;
    RecordMasks _masks;
    bool _events = false;
    bool _texts = false;
};

}  // namespace kelvo::modem
