#pragma once

#include <algorithm>
#include <memory>
#include <utility>

#include "platform/system/MainQueue.h"
#include "telephony/line/ModemLines.h"
#include "telephony/wire/modem/ModemPort.h"

namespace kelvo::test {

/// The way between a played modem and the service's source without a system in between: what one end sends, the other
/// has in the queue's next task. The modem's end takes 8 KiB a moment.
struct Cable {
    ModemLine::Listener* reader = nullptr;  // of the line that is open
    bool pluggedIn = false;
    std::function<void(ByteView)> toModem;
};

class CablePort final : public modem::ModemPort {
public:
    CablePort(std::shared_ptr<Cable> cable, MainQueue& queue) : _cable(std::move(cable)), _queue(queue) {}

    Result<void> plugIn() override {
        _cable->toModem = onReceived;
        _cable->pluggedIn = true;
        return {};
    }
    void unplug() override {
        _cable->pluggedIn = false;
        post([](ModemLine::Listener& reader) { reader.lineClosed("it hung up"); });
    }
    std::string place() const override { return "line"; }
    std::size_t send(ByteView bytes) override {
        if (std::exchange(_moment, _queue.now()) != _queue.now()) _room = 8192;
        if (_cable->reader == nullptr) return 0;
        const std::size_t taken = std::min(_room, bytes.size());
        _room -= taken;
        post([piece = Bytes(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(taken))](
                 ModemLine::Listener& reader) mutable { reader.lineGave(piece); });
        return taken;
    }

private:
    // For the reader of now, if it is still there then.
    template <class Call>
    void post(Call call) {
        _queue.post([cable = _cable, reader = _cable->reader, call]() mutable {
            if (reader != nullptr && cable->reader == reader) call(*reader);
        });
    }

    const std::shared_ptr<Cable> _cable;
    MainQueue& _queue;
    std::chrono::nanoseconds _moment{-1};
    std::size_t _room = 0;
};

class CableLine final : public ModemLine {
public:
    CableLine(std::shared_ptr<Cable> cable, MainQueue& queue, Listener& listener)
        : _cable(std::move(cable)), _queue(queue), _listener(listener) {}
    ~CableLine() override { mute(); }

    std::string name() const override { return "line"; }
    void open() override {
        _cable->reader = &_listener;
        _open = true;
        _listener.lineOpened();
    }
    void send(ByteView frame) override {
        _queue.post([cable = _cable, bytes = Bytes(frame.begin(), frame.end())] {
            if (cable->pluggedIn) cable->toModem(bytes);
        });
    }
    void mute() override {
        if (std::exchange(_open, false)) _cable->reader = nullptr;
    }

private:
    const std::shared_ptr<Cable> _cable;
    MainQueue& _queue;
    Listener& _listener;
    bool _open = false;
};

class CableLines final : public ModemLines {
public:
    CableLines(std::shared_ptr<Cable> cable, MainQueue& queue) : _cable(std::move(cable)), _queue(queue) {}

    std::string description() const override { return "the modem at line"; }
    Result<std::unique_ptr<ModemLine>> next(ModemLine::Listener& listener, bool) override {
        if (!_cable->pluggedIn) return Failure{"No such file or directory"};
        return std::unique_ptr<ModemLine>(std::make_unique<CableLine>(_cable, _queue, listener));
    }
    void watch(std::function<void()>) override {}

private:
    const std::shared_ptr<Cable> _cable;
    MainQueue& _queue;
};

}  // namespace kelvo::test
