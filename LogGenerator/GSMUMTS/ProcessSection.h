#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/RegistrationRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// What the registration processes share: each shows a state of its own, `Derived::kState`, and all of them the
/// registration state. `Derived` says with `kTraceWord` what each record writes to the log.
template <class Derived>
class ProcessSection : public Section<Derived> {
public:
    using Section<Derived>::Section;

    void updateWithData(ByteView data, LogCode logCode) final {
        logLine(Level::Warning, Derived::kTraceWord);
        this->showOneOf(data, logCode, Derived::kState, RegistrationRecord::kState);
    }
};

}  // namespace kelvo
