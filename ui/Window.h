#pragma once

namespace kelvo {

class KelvoApp;

/// The application's one window. Destroying it closes it and lets go of everything it draws.
class Window {
public:
    virtual ~Window() = default;

    /// Makes the application's navigation stack the root screen.
    virtual void setRootScreen(KelvoApp& application) = 0;
    virtual void makeKeyAndVisible() = 0;
    virtual void orderOut() = 0;  ///< takes the window off screen
};

}  // namespace kelvo
