#pragma once

#include <sys/types.h>

#include <QDBusConnection>
#include <QDBusMessage>
#include <QObject>
#include <functional>
#include <string>

#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"

namespace kelvo::modemmanager {

/// ModemManager's end of the bus: who owns its name, and questions to that owner. The name counts only while it belongs
/// to the user whom we trust, and everything is asked of and heard from its owner's own address, so that nobody else
/// can speak in its place. Nothing waits for an answer. Main queue only.
class BusCalls : public QObject {
    Q_OBJECT
public:
    using Answer = std::function<void(const QDBusMessage&)>;  ///< a reply, or an error by its type
    /// Opens the bus; what comes may be unconnected.
    using Open = std::function<QDBusConnection()>;

    /// Whoever asks.
    class Listener {
    public:
        virtual ~Listener() = default;
        virtual void managerCame() = 0;
        virtual void managerWent() = 0;                                 ///< or never came; trouble() may say more now
        virtual void managerSignalled(const QDBusMessage& signal) = 0;  ///< any signal of the daemon's
        virtual void answersOrNot() = 0;                                ///< isSilent() has changed
    };

    /// `queue` and `listener` outlive it. `trustedOwner` is the user id that the name must belong to.
    BusCalls(Open open, uid_t trustedOwner, MainQueue& queue, Listener& listener);
    ~BusCalls() override;

    void begin() { connectBus(); }

    /// Asks the daemon. The answer of one that has gone meanwhile never comes.
    void ask(const QString& path, const QString& interface, const QString& method, const QVariantList& arguments,
             Answer answer);

    bool hasManager() const { return !_owner.isEmpty(); }
    /// A question has stood for a while without an answer.
    bool isSilent() const { return _silent; }
    /// Why there is no daemon.
    const std::string& trouble() const { return _trouble; }

private Q_SLOTS:
    void nameOwnerChanged(const QString& name, const QString& before, const QString& now);
    void busGone();
    void signalled(const QDBusMessage& signal);

private:
    void connectBus();
    void askBus(const QString& method, const QString& argument, Answer answer);
    void send(const QDBusMessage& question, Answer answer);
    void findOwner();
    void checkOwner(const QString& owner);
    void trust(const QString& owner);
    void lose(std::string trouble);
    void setSilent(bool silent);
    QDBusConnection bus() const;

    const Open _open;
    const uid_t _trustedOwner;
    MainQueue& _queue;
    Listener& _listener;
    QString _name;       // of the connection; empty: there is none
    QString _owner;      // the daemon's own address; empty: none that is trusted
    unsigned _turn = 0;  // counts owners: an answer of an earlier one is nobody's
    bool _silent = false;
    std::string _trouble;
    Lifetime _lifetime;
};

}  // namespace kelvo::modemmanager
