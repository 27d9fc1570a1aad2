#include "telephony/simulation/Journey.h"

#include <cmath>
#include <numbers>
#include <utility>

namespace kelvo::simulation {
namespace {

constexpr double kDegrees = 180 / std::numbers::pi;
constexpr int kCorners = 14;

}  // namespace

double distance(Point a, Point b) {
    // The last bit of a hypot is another one on arm64; that of a root is the standard's, and no distance is large.
    const double east = b.east - a.east;
    const double north = b.north - a.north;
    return std::sqrt(east * east + north * north);
}

double bearing(Point from, Point to) {
    const double degrees = std::atan2(to.east - from.east, to.north - from.north) * kDegrees;
    return degrees < 0 ? degrees + 360 : degrees;
}

Journey::Journey(std::vector<Corner> corners) : _corners(std::move(corners)) {
    for (std::size_t i = 0; i < _corners.size(); ++i) {
        const double metres = distance(_corners[i].at, _corners[(i + 1) % _corners.size()].at);
        _lapMetres += metres;
        _lapSeconds += _corners[i].stop + metres / _corners[i].speed;
    }
}

Journey Journey::through(double radius, Random& random) {
    std::vector<Corner> corners;
    for (int i = 0; i < kCorners; ++i) {
        const double angle = 2 * std::numbers::pi * i / kCorners;
        const double reach = radius * random.between(0.35, 0.9);
        const double speed = random.between(8.0, 19.5);  // 30 to 70 km/h
        const double stop = random.chance(0.4) ? random.between(5.0, 25.0) : 0.0;
        corners.push_back({{reach * std::sin(angle), reach * std::cos(angle)}, speed, stop});
    }
    return Journey(std::move(corners));
}

Point Journey::at(Time time) const { return find(time).at; }

double Journey::driven(Time time) const { return find(time).driven; }

Journey::Position Journey::find(Time time) const {
    const double laps = std::floor(seconds(time) / _lapSeconds);
    double left = seconds(time) - laps * _lapSeconds;
    double driven = laps * _lapMetres;
    for (std::size_t i = 0; i < _corners.size(); ++i) {
        const Corner& from = _corners[i];
        const Point to = _corners[(i + 1) % _corners.size()].at;
        const double metres = distance(from.at, to);
        if (left < from.stop) return {from.at, driven};
        left -= from.stop;
        if (left * from.speed < metres) {
            const double part = left * from.speed / metres;
            const Point at{std::lerp(from.at.east, to.east, part), std::lerp(from.at.north, to.north, part)};
            return {at, driven + left * from.speed};
        }
        left -= metres / from.speed;
        driven += metres;
    }
    return {_corners.front().at, driven};
}

}  // namespace kelvo::simulation
