#pragma once

#include <filesystem>
#include <memory>

#include "platform/host/FdWatcher.h"
#include "platform/host/UniqueFd.h"
#include "platform/system/MainQueue.h"
#include "telephony/wire/modem/ModemPort.h"

namespace kelvo::modem {

/// A pseudo-terminal, with a symbolic link to it where one is asked for. The link replaces another link to a
/// pseudo-terminal, which is what a modem leaves behind that was killed, and nothing else; it goes with the terminal.
class PseudoTerminal final : public ModemPort {
public:
    /// An empty `link`: none. `queue` outlives the port.
    PseudoTerminal(std::filesystem::path link, MainQueue& queue) : _link(std::move(link)), _queue(queue) {}
    ~PseudoTerminal() override { unplug(); }

    Result<void> plugIn() override;
    void unplug() override;
    std::string place() const override { return _link.empty() ? _path : _link.string(); }
    std::size_t send(ByteView bytes) override;

private:
    Result<void> makeLink();
    bool isHungUp() const;
    void read();
    void waitForReader();
    void lookForReader();

    const std::filesystem::path _link;
    MainQueue& _queue;
    UniqueFd _master;
    std::string _path;
    std::unique_ptr<FdWatcher> _incoming;
    std::unique_ptr<FdWatcher> _room;
    std::unique_ptr<RepeatingTimer> _absent;  // while nobody has it open
};

}  // namespace kelvo::modem
