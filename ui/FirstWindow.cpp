#include "ui/FirstWindow.h"

#include <QGuiApplication>
#include <QWindow>
#include <chrono>

namespace kelvo {
namespace {

using namespace std::chrono_literals;

constexpr const char* kActivation = "XDG_ACTIVATION_TOKEN";  // a launcher's word that the window may take the focus
constexpr std::size_t kLongestToken = 1000;

void comeToTheFront(ByteView token) {
    if (!token.empty() && token.size() <= kLongestToken) {
        const auto* const text = reinterpret_cast<const char*>(token.data());
        qputenv(kActivation, QByteArray(text, static_cast<qsizetype>(token.size())));
    }
    for (QWindow* const window : QGuiApplication::topLevelWindows()) {
        if (!window->isVisible()) continue;
        window->raise();
        window->requestActivate();
    }
}

}  // namespace

FirstWindow::FirstWindow(MessagePorts& ports, const std::string& name) {
    auto made = ports.createLocal(name, [](std::int32_t, ByteView token) {
        comeToTheFront(token);
        return Bytes{};
    });
    _port = std::move(made.port);
    if (_port) _port->schedule();
    const auto other = made.alreadyExisted ? ports.openRemote(name) : nullptr;
    if (!other) return;  // this is the first, or the other is just ending
    const QByteArray token = qgetenv(kActivation);
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(token.constData());
    _isElsewhere =
        static_cast<bool>(other->request(0, ByteView(bytes, static_cast<std::size_t>(token.size())), 1s, 1s));
}

}  // namespace kelvo
