#pragma once

#include <string>

#include "platform/values/Bytes.h"
#include "ui/SavedScreens.h"

namespace kelvo::test {

/// One refresh of an LTE phone: one section, and one neighbor, as a snapshot file has it.
inline std::string refreshXml(const std::string& date, const std::string& rsrp, const std::string& neighbor) {
    return "<dict><key>DisplayState</key><data></data><key>Display</key><dict>"
           "<key>_sorted</key><string></string>"
           "<key>02;Measured Neighbor Cells</key><array><dict><key>Physical Cell ID</key><string>" +
           neighbor +
           "</string><key>Filtered RSRP</key><string>-101.00 dBm</string></dict></array>"
           "<key>01;Serving Cell Measurements</key><dict><key>Physical Cell ID</key><string>301</string>"
           "<key>Measured RSRP</key><string>" +
           rsrp + "</string></dict></dict><key>ExtraInfo</key><dict/><key>Date</key><string>" + date +
           "</string></dict>";
}

/// A snapshot file around `entries`.
inline std::string snapshotXml(const std::string& entries, const std::string& description = "at the bridge") {
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n<dict>\n"
           "\t<key>Timestamp</key>\n\t<string>2011-03-04 09:15:02 +0000</string>\n\t<key>Data</key>\n\t<array>" +
           entries + "</array>\n\t<key>Description</key>\n\t<string>" + description + "</string>\n</dict>\n</plist>\n";
}

/// Three refreshes, two seconds apart, the last two seconds before the snapshot, told in another zone; then the DLF.
inline std::string sampleSnapshot() {
    return snapshotXml(refreshXml("2011-03-04 10:14:56 +0100", "-95.00 dBm", "17") +
                       refreshXml("2011-03-04 10:14:58 +0100", "-95.00 dBm", "17") +
                       refreshXml("2011-03-04 10:15:00 +0100", "-97.50 dBm", "17") +
                       "<dict><key>Description</key><string>DLF binary (4 bytes)</string>"
                       "<key>DLF</key><data>BAUGBw==</data></dict>");
}

inline std::shared_ptr<const SavedScreens> savedScreens(const std::string& xml) {
    return std::make_shared<const SavedScreens>(SnapshotFile::read("in.kelvo", bytesOf(xml)).value());
}

}  // namespace kelvo::test
