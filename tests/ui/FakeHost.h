#pragma once

#include "tests/support/ManualQueue.h"
#include "ui/ScreenHost.h"

namespace kelvo::test {

/// An application that only notes what its screens ask of it.
class FakeHost final : public ScreenHost {
public:
    MainQueue& queue() const override { return tasks; }
    bool allowSaveButton() const override { return savingAllowed; }
    void showSaveView() override { ++saveViewsShown; }
    void closeSaveView() override { ++saveViewsClosed; }
    std::optional<std::chrono::milliseconds> ageOf(const KelvoModelNode&) const override { return age; }
    void showDetails(const std::string& path, int) override { detailsShown.push_back(path); }
    void closeDetails() override { ++detailsClosed; }
    void showAlert(const QString& title, const QString& message, const QString& button) override {
        alerts.append(title + QLatin1Char('|') + message + QLatin1Char('|') + button);
    }

    mutable ManualQueue tasks;
    bool savingAllowed = false;
    int saveViewsShown = 0;
    int saveViewsClosed = 0;
    std::vector<std::string> detailsShown;
    int detailsClosed = 0;
    std::optional<std::chrono::milliseconds> age;  // of every value
    QStringList alerts;
};

}  // namespace kelvo::test
