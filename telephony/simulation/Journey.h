#pragma once

#include <vector>

#include "telephony/simulation/Random.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// A place in the town; metres east and north of its centre.
struct Point {
    double east = 0;
    double north = 0;
};

double distance(Point a, Point b);  ///< metres
/// The direction from `from` to `to`: degrees clockwise from north, 0 to 360.
double bearing(Point from, Point to);

/// A car on its road: drives from corner to corner at its speed, stops at some of them (lights, a shop), and begins
/// again where the road, which is closed, began.
class Journey {
public:
    struct Corner {
        Point at;
        double speed = 13.9;  ///< m/s from here to the next corner
        double stop = 0;      ///< seconds of standing here
    };

    /// At least two corners; every speed above 0.
    explicit Journey(std::vector<Corner> corners);
    /// A round trip within `radius` metres of the town's centre, with stops.
    static Journey through(double radius, Random& random);
    static Journey throughTown(Random& random) { return through(2000, random); }

    Point at(Time time) const;
    /// Metres driven up to then; standing adds none.
    double driven(Time time) const;

private:
    struct Position {
        Point at;
        double driven;
    };
    Position find(Time time) const;

    std::vector<Corner> _corners;
    double _lapSeconds = 0;
    double _lapMetres = 0;
};

}  // namespace kelvo::simulation
