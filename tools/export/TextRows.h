#pragma once

#include <memory>
#include <string>
#include <vector>

#include "tools/export/Notation.h"
#include "tools/export/OutputThread.h"
#include "tools/export/ReadingRows.h"

namespace kelvo {

/// One line of text a reading.
class TextRows final : public ReadingRows {
public:
    /// `output` outlives it.
    TextRows(std::unique_ptr<Notation> notation, OutputThread& output);

    void write(const Moment& moment, std::span<const Written> readings) override;
    void finish() override;

private:
    struct Rendered {
        std::int64_t raw = 0;
        const Quantity* quantity = nullptr;
        std::string text{};
    };

    const std::string& rendered(const Value& value);

    std::unique_ptr<Notation> _notation;
    OutputThread& _output;
    MomentText _time;
    std::string _rows;                // to be written next; at first the heading
    std::vector<Rendered> _readings;  // by a hash of raw number and quantity: the same come again and again
    std::string _otherText;           // of a text that is no reading
    std::string _start;
    std::string _end;
};

}  // namespace kelvo
