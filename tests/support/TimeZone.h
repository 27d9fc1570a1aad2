#pragma once

#include <cstdlib>
#include <ctime>
#include <optional>
#include <string>

namespace kelvo::test {

/// Takes the process into a time zone for as long as it lives.
class TimeZone {
public:
    explicit TimeZone(const char* zone) {
        if (const char* before = ::getenv("TZ")) _before = before;
        enter(zone);
    }
    ~TimeZone() { enter(_before ? _before->c_str() : nullptr); }
    TimeZone(const TimeZone&) = delete;
    TimeZone& operator=(const TimeZone&) = delete;

private:
    static void enter(const char* zone) {
        if (zone != nullptr) {
            ::setenv("TZ", zone, 1);
        } else {
            ::unsetenv("TZ");
        }
        ::tzset();
    }

    std::optional<std::string> _before;
};

}  // namespace kelvo::test
