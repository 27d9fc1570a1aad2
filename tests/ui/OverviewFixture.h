#pragma once

#include <QAccessible>
#include <QStringList>
#include <string>

#include "tests/overview/Shown.h"
#include "tests/ui/DetailsFixture.h"

namespace kelvo::test {

/// A scene with the overview: of an LTE modem's records, or of displays that are made by hand.
class OverviewFixture : public DetailsFixture {
protected:
    /// A modem of that technology, without any value yet.
    void startModem(std::string_view technology, QSize size = {412, 915}) {
        scene.reset();
        scene = std::make_unique<Scene>(false, size);
        scene->ports.onRequest = speaking(std::string(technology));
        scene->connect();
        if (technology == kPLLogChannelTechnology_IFX) {
            scene->show(Dictionary::make({{"A", "1"}, {"B", "2"}}));
        } else {
            scene->ports.deliver(KelvoModel::kLogChannelPortName, 0, Record(0x1FFF, 13).bytes());
            scene->pass(2s);
        }
        scene->settle();
    }
    /// The screens have these values now, as records would have left them there.
    void showValues(const Value& groups) {
        const DictionaryRef display = scene->app().model()->display().dictionary();
        for (const auto& group : *groups.dictionary()) display->set(group.key, group.value);
        scene->app().updateViewControllerFromModel();
        scene->settle();
    }
    void openOverview() {
        scene->press(Qt::Key_O, Qt::ControlModifier);
        scene->settle();
        ASSERT_NE(overview(), nullptr);
    }
    QQuickItem* overview() { return scene->itemOfType("OverviewView"); }
    bool isOpen() { return scene->app().overview()->isOpen(); }
    /// Whether the keyboard is within.
    static bool hasFocus(const QQuickItem* item) { return item != nullptr && item->hasActiveFocus(); }
    QQuickItem* panes() { return scene->itemOfType("QQuickStackView"); }

    /// All that a screen reader reads from the overview, in its order.
    QStringList heard() {
        QStringList names;
        listen(QAccessible::queryAccessibleInterface(overview()), names);
        return names;
    }
    bool isHeard(const char* words) { return heard().contains(QString::fromUtf8(words)); }
    static std::string joined(const QStringList& lines) { return lines.join(u'\n').toStdString(); }
    /// The top edges of the sections, where their names stand.
    std::vector<double> places() {
        std::vector<double> places;
        for (const char* section : {"overviewServing", "levelGauge", "qualityGauge", "overviewCells",
                                    "overviewRegistration", "overviewEvents"}) {
            places.push_back(named(section)->mapToScene({0, 0}).y());
        }
        return places;
    }
    void tapEvent(const char* title) {
        scene->tapText(text(title));
        scene->settle();
    }

private:
    static void listen(QAccessibleInterface* item, QStringList& names) {
        if (item == nullptr || item->state().invisible) return;
        if (const QString name = item->text(QAccessible::Name); !name.isEmpty()) names.append(name);
        for (int child = 0; child < item->childCount(); ++child) listen(item->child(child), names);
    }
};

}  // namespace kelvo::test
