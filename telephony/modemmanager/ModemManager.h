#pragma once

#include <map>
#include <set>

#include "telephony/modemmanager/BusCalls.h"
#include "telephony/modemmanager/ModemObjects.h"
#include "telephony/phone/PhoneService.h"

namespace kelvo::modemmanager {

/// ModemManager as the service that knows the phone. It reads, and changes one thing: while somebody measures, the
/// daemon is asked for fresh signal values every second; afterwards that is as it was.
class ModemManager final : public phone::PhoneService, private BusCalls::Listener {
public:
    /// `wanted` is a modem's index, path or equipment identity; empty: the first. The others as BusCalls has them.
    ModemManager(BusCalls::Open open, uid_t trustedOwner, std::string wanted, MainQueue& queue);

    void follow(std::function<void()> changed) override;
    void measure(bool wanted) override;
    void release(std::function<void()> done) override;
    const phone::PhoneState& phone() const override { return _phone; }
    std::string description() const override;
    std::string trouble() const override;
    std::vector<std::string> lacks() const override;

    /// Every modem that there is, the first first.
    std::vector<phone::PhoneState> modems() const;
    /// Asks once for the cells of the modem that is followed, as measuring does, but for nothing that would change the
    /// daemon; `done` is called when it has answered, and the news follow on the queue.
    void look(std::function<void()> done);
    /// Everything that was asked so far has been answered.
    bool isSettled() const { return _loading == 0; }

private:
    void managerCame() override;
    void managerWent() override;
    void managerSignalled(const QDBusMessage& signal) override;
    void answersOrNot() override { note(); }

    void load();
    void loadParts();
    void loadPart(const QString& path, const char* interface);
    void choose();
    bool isWanted(const QString& modem) const;
    void note();
    void tell();
    void poll();
    void askCells(std::function<void()> done);
    void askLocation(std::function<void()> done);
    void settleSignal();
    void tellRefusal(const std::string& what, const QString& method, const QDBusMessage& error);
    void finish();

    BusCalls _bus;
    MainQueue& _queue;
    const std::string _wanted;
    std::function<void()> _changed;
    ModemObjects _known;
    QString _modem;  // that is followed; empty: none
    phone::PhoneState _phone;
    unsigned _loading = 0;
    bool _noted = false;
    bool _measuring = false;
    bool _polling = false;               // the next poll is on the queue
    bool _asking = false;                // cells have been asked for
    std::optional<quint32> _rateBefore;  // the daemon's own, while ours is set
    bool _settingRate = false;           // the answer is awaited
    std::set<QString> _notToBeHad;       // methods that are refused, or not there: not asked again while this lasts
    std::map<std::string, std::string> _lacks;  // reason, by what cannot be had
    std::set<std::string> _toldRights;          // rights that are missing have a log line each
    std::function<void()> _done;                // to be told when the daemon has been left as it was
    Lifetime _lifetime;
};

}  // namespace kelvo::modemmanager
