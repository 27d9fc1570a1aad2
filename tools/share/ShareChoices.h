#pragma once

namespace kelvo {

/// What the user wants replaced besides what always is: numbers and identities of SIM, subscriber and phone, temporary
/// identities, telephone numbers and addresses.
struct ShareChoices {
    bool hideCells = true;    ///< cells, areas and networks
    bool hideApns = false;    ///< access point names
    bool shiftTimes = false;  ///< the first time becomes the beginning of 2020; intervals stay
};

}  // namespace kelvo
