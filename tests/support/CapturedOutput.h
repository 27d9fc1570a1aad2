#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

namespace kelvo::test {

/// A program's standard output that is kept.
class CapturedOutput {
public:
    CapturedOutput() = default;
    ~CapturedOutput() {
        std::fclose(_file);
        std::free(_text);
    }
    CapturedOutput(const CapturedOutput&) = delete;
    CapturedOutput& operator=(const CapturedOutput&) = delete;

    std::FILE* file() const { return _file; }
    std::string text() const {
        std::fflush(_file);
        return _text;
    }

private:
    char* _text = nullptr;
    std::size_t _size = 0;
    std::FILE* _file = ::open_memstream(&_text, &_size);
};

}  // namespace kelvo::test
