#pragma once

#include "ui/ScreenHost.h"

namespace kelvo::test {

/// An application that only notes what its screens ask of it.
class FakeHost final : public ScreenHost {
public:
    bool allowSaveButton() const override { return savingAllowed; }
    void showSaveView() override { ++saveViewsShown; }
    void closeSaveView() override { ++saveViewsClosed; }
    void showAlert(const QString& title, const QString& message, const QString& button) override {
        alerts.append(title + QLatin1Char('|') + message + QLatin1Char('|') + button);
    }

    bool savingAllowed = false;
    int saveViewsShown = 0;
    int saveViewsClosed = 0;
    QStringList alerts;
};

}  // namespace kelvo::test
