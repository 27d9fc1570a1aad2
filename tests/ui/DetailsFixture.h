#pragma once

#include <QTest>
#include <cmath>
#include <utility>
#include <vector>

#include "tests/support/Record.h"
#include "tests/ui/ScreenFixture.h"
#include "ui/TrendChart.h"

namespace kelvo::test {

/// A scene with an LTE modem in a connection, which reports the serving cell's level and its neighbors'.
class DetailsFixture : public ScreenFixture {
protected:
    using Cells = std::vector<std::pair<std::uint32_t, double>>;  // PCI and RSRP in dBm
    static constexpr const char* kSection = "Connected mode LTE Intra-frequency Measurement";

    void startLte(QSize size = {412, 915}) {
        scene.reset();
        scene = std::make_unique<Scene>(false, size);
        scene->ports.onRequest = speaking(std::string(kPLLogChannelTechnology_Oskra_LTE));
        scene->connect();
        measure(-95);
        scene->settle();
    }
    /// A record of what is measured, and the refresh that shows it.
    void measure(double level, const Cells& neighbors = {}, std::uint32_t servingCell = 301) {
        Record record(0xB179, 29 + 6 * neighbors.size());
        record.u16(17, 1300).u16(19, servingCell).u16(23, raw(level)).u16(25, 80);
        record.u8(27, static_cast<std::uint32_t>(neighbors.size()));
        for (std::size_t i = 0; i < neighbors.size(); ++i) {
            record.u16(29 + 6 * i, neighbors[i].first).u16(31 + 6 * i, raw(neighbors[i].second));
        }
        scene->ports.deliver(KelvoModel::kLogChannelPortName, 0, record.bytes());
        scene->pass(2s);
    }
    static std::uint32_t raw(double level) { return static_cast<std::uint32_t>(std::lround((level + 140) * 4)); }

    void openSection(const char* section = kSection) {
        scene->tapText(text(section));
        expectTop(section);
    }
    /// The keyboard goes to the row and asks for its details.
    void askAt(int row) {
        for (int presses = 0; presses <= row; ++presses) scene->press(Qt::Key_Down);
        scene->press(Qt::Key_Return, Qt::ControlModifier);
        scene->settle();
    }
    /// The details of the serving cell's RSRP.
    void openDetails() {
        scene->app().showDetails(std::string("/") + kSection + "/Serving Filtered RSRP", 0);
        scene->settle();
        ASSERT_NE(scene->app().details(), nullptr);
    }
    TrendChart* chart() {
        auto* found = qobject_cast<TrendChart*>(scene->itemOfType("kelvo::TrendChart"));
        EXPECT_NE(found, nullptr);
        return found;
    }
    QQuickItem* named(const char* objectName) {
        return scene->view().rootObject()->findChild<QQuickItem*>(text(objectName));
    }
    QString textOf(const char* objectName) { return named(objectName)->property("text").toString(); }
};

}  // namespace kelvo::test
