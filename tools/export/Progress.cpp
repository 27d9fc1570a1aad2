#include "tools/export/Progress.h"

#include <fmt/format.h>
#include <unistd.h>

#include <cstdlib>

namespace kelvo {

namespace {

using namespace std::chrono_literals;

constexpr auto kPatience = 1s;
constexpr auto kBetween = 200ms;
constexpr int kBar = 30;

std::string grouped(std::uint64_t number) {
    std::string text = std::to_string(number);
    for (std::size_t at = text.size(); at > 3; at -= 3) text.insert(at - 3, 1, ',');
    return text;
}

}  // namespace

Progress::Progress(std::function<void(std::string_view)> draw, SteadyTime now)
    : _draw(std::move(draw)), _now(std::move(now)), _due(_now() + kPatience) {}

Progress::~Progress() { clear(); }

bool Progress::isDue() {
    const auto now = _now();
    if (now < _due) return false;
    _due = now + kBetween;
    return true;
}

void Progress::show(std::uint64_t records, std::optional<double> portion) {
    std::string line = "\r";
    if (portion) {
        const int done = static_cast<int>(*portion * kBar);
        line += fmt::format("[{:#<{}}{:.<{}}] {:3} %  ", "", done, "", kBar - done, static_cast<int>(*portion * 100));
    }
    line += fmt::format("{} records\x1B[K", grouped(records));
    _isShown = true;
    _draw(line);
}

void Progress::clear() {
    if (_isShown) _draw("\r\x1B[K");
    _isShown = false;
}

std::function<void(std::string_view)> progressOnTerminal(bool rowsGoToStandardOutput) {
    const char* type = std::getenv("TERM");
    const bool obeys = type != nullptr && type[0] != '\0' && std::string_view(type) != "dumb";
    if (!obeys || ::isatty(STDERR_FILENO) == 0) return {};
    if (rowsGoToStandardOutput && ::isatty(STDOUT_FILENO) != 0) return {};
    return [](std::string_view text) { fmt::print(stderr, "{}", text); };
}

}  // namespace kelvo
