#pragma once

#include <QString>
#include <chrono>
#include <optional>
#include <string>

#include "model/KelvoModelNode.h"
#include "platform/system/MainQueue.h"

namespace kelvo {

/// What a screen may ask of the application that shows it. Main thread only.
class ScreenHost {
public:
    virtual ~ScreenHost() = default;

    virtual MainQueue& queue() const = 0;
    /// Whether panes offer to save; decided once, at launch.
    virtual bool allowSaveButton() const = 0;
    /// Presents the save screen over the panes; does nothing while one is there.
    virtual void showSaveView() = 0;
    /// Takes the save screen away and releases it.
    virtual void closeSaveView() = 0;
    /// How long ago a record wrote the node's value, in the stream's time; none while nobody knows.
    virtual std::optional<std::chrono::milliseconds> ageOf(const KelvoModelNode& node) const = 0;
    /// Presents the details of the value at `path`, or of the list's row there, which stands in that row of the pane on
    /// top; does nothing while a screen is presented already.
    virtual void showDetails(const std::string& path, int row) = 0;
    /// Takes the details away and releases them.
    virtual void closeDetails() = 0;
    /// Shows an alert with one button over everything; it stays until the button is pressed.
    virtual void showAlert(const QString& title, const QString& message, const QString& button) = 0;
};

}  // namespace kelvo
