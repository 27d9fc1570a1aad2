#pragma once

#include <array>
#include <chrono>
#include <optional>

#include "platform/telephony/Technology.h"
#include "telephony/wire/RecordConfiguration.h"

namespace kelvo::wire {

/// Which of the technologies that a modem speaks its phone is camped on: the one whose records come. Time is handed in.
class CampedTechnology {
public:
    using nanoseconds = std::chrono::nanoseconds;

    /// The records that a camped phone writes, a few of each technology.
    static const RecordCodes& codes();
    /// The technology that such a record speaks of; none for another record.
    static std::optional<Technology> technologyOf(LogCode code);

    /// Listening begins: the modem has been asked for the codes.
    void begin(nanoseconds now);
    bool isListening() const { return _began.has_value(); }
    /// Listening has ended; what is known stays.
    void pause() { _began.reset(); }
    void forget();
    void heard(LogCode code, nanoseconds now);
    /// Takes the time into account: settles the first answer after half a second, or three seconds when nothing was
    /// heard (then by what the modem has), and notices later that another technology has taken over. True when the
    /// answer is new.
    bool settle(const Ranges& ranges, nanoseconds now);
    /// When to call settle() next; none while nothing was begun.
    std::optional<nanoseconds> deadline() const;
    /// None: not known yet.
    std::optional<Technology> known() const { return _known; }

private:
    using Heard = std::array<unsigned, kTechnologies.size()>;

    std::optional<Technology> mostHeard() const;
    bool conclude(std::optional<Technology> technology, nanoseconds now);

    std::optional<nanoseconds> _began;  // of the listening, or of the interval that runs
    Heard _heard{};
    std::optional<Technology> _known;
};

}  // namespace kelvo::wire
