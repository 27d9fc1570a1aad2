#pragma once

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/LTE/Air.h"

/// What an LTE modem reports, in physical units: the records are made of it.
namespace kelvo::simulation::lte {

/// A cell beside the serving one, as it was last measured.
struct Neighbor {
    Pci pci;
    Reading reading;
    double srxlev = 0;       ///< dB: its level above what it asks for
    int frequencyError = 0;  ///< Hz
    int frames = 0;          ///< its frame count is ahead by so many
    int samples = 0;         ///< its frames arrive so many samples (1/30.72 us) later
};

/// What an idle phone makes of its serving cell (3GPP TS 36.304, section 5.2).
struct IdleState {
    enum Rule { SearchIntra = 1, SearchInter = 2, SearchOther = 4 };
    double srxlev = 0;     ///< dB
    int failedCycles = 0;  ///< DRX cycles in a row with a srxlev of 0 or less
    int rules = 0;         ///< what the phone looks for: Rule bits
    bool rulesChanged = false;
};

class Modem;

/// The serving cell and the two strongest of those listed.
std::vector<MonitoredCell> monitoredCells(const Modem& modem);
std::vector<PdpContext> pdpContexts(const Modem& modem);

}  // namespace kelvo::simulation::lte
