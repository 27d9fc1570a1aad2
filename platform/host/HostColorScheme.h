#pragma once

#include <QDBusConnection>
#include <QDBusVariant>
#include <QObject>
#include <QString>
#include <functional>
#include <optional>

namespace kelvo {

/// Whether the desktop wants programs light or dark, as its portal tells (org.freedesktop.appearance, color-scheme).
/// Asking never blocks: the answer, and every change after it, comes on the main queue. Where there is no session bus
/// or no portal nothing is ever told.
class HostColorScheme : public QObject {
    Q_OBJECT
public:
    enum class Scheme { NoPreference, Dark, Light };

    explicit HostColorScheme(std::function<void(Scheme)> told);
    ~HostColorScheme() override;

private Q_SLOTS:
    void settingChanged(const QString& group, const QString& key, const QDBusVariant& value);

private:
    void ask();
    void tell(const QVariant& value);

    const std::function<void(Scheme)> _told;
    std::optional<QDBusConnection> _bus;
    std::optional<Scheme> _scheme;  // the last that was told
};

}  // namespace kelvo
