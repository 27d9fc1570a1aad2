#pragma once

#include <gtest/gtest.h>

#include "telephony/simulation/Reported.h"

namespace kelvo::test {

/// Plays ten minutes, in which the phone must receive its serving cell unchanged whenever it stands still, and calls
/// `check(level)`, dBm, for each message once it has stood on one cell for `settling`. The number of those messages.
template <class Simulation, class Check>
int checkStanding(Simulation& modem, simulation::Time settling, Check check) {
    simulation::Time since{0};
    double driven = -1;
    double level = 0;
    int steady = 0;
    simulation::Reported<std::size_t> serving;
    for (auto message = modem.next(); message.time < std::chrono::minutes(10); message = modem.next()) {
        const auto& drive = modem.air().drive();
        const double received = drive.received(modem.modem().servingIndex());
        const bool hasMoved = serving.isDue(message.time, modem.modem().servingIndex());
        if (drive.driven() != driven || hasMoved) {
            since = message.time;
            driven = drive.driven();
            level = received;
            continue;
        }
        EXPECT_EQ(received, level);
        if (message.time - since < settling) continue;
        check(level);
        ++steady;
    }
    return steady;
}

}  // namespace kelvo::test
