#pragma once

#include <stdexcept>
#include <string>

#include "platform/host/Capture.h"

namespace kelvo::test {

/// A capture that a test writes, over an earlier one of the name too.
inline CaptureWriter captureAt(const std::string& path, Technology technology) {
    auto file = OutputFile::create(path, {.replace = true});
    if (!file) throw std::runtime_error(file.error().reason);
    auto writer = CaptureWriter::create(std::move(file).value(), technology);
    if (!writer) throw std::runtime_error(writer.error().reason);
    if (const auto appeared = writer->appear(); !appeared) throw std::runtime_error(appeared.error().reason);
    return std::move(writer).value();
}

}  // namespace kelvo::test
