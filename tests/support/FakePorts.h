#pragma once

#include <functional>
#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "platform/system/MessagePorts.h"

namespace kelvo::test {

/// Message ports without sockets. The test is the other process: it listens under names, answers requests, delivers
/// messages to local ports and dies. Outlives the ports it makes.
class FakePorts final : public MessagePorts {
public:
    /// One message as it left the program.
    struct Sent {
        std::string portName;
        std::int32_t id;
        Bytes data;
        std::chrono::nanoseconds sendLimit;
        std::optional<std::chrono::nanoseconds> replyLimit;
    };
    using Answer = Result<Bytes, RemotePort::Error>;

    // What the other process does; changed at any time.
    std::function<Answer(const Sent&)> onRequest = [](const Sent&) { return Bytes(); };
    std::set<std::string> listening = {"service"};  ///< names under which it can be reached
    std::set<std::string> taken;                    ///< names that live ports of other programs hold
    bool refusesLocalPorts = false;

    std::vector<Sent> sent;  ///< every message, in order

    /// Delivers a message to the local port `name`; none when there is no such port or it is not scheduled.
    std::optional<Bytes> deliver(const std::string& name, std::int32_t id, const Bytes& data);
    /// The other process dies: every remote port becomes invalid, and nobody listens any more.
    void killPeer();

    LocalPort* local(const std::string& name) const;
    std::size_t openLocals() const { return _locals.size(); }
    std::size_t openRemotes() const { return _remotes.size(); }

    Local createLocal(std::string_view name, MessageCallback callback) override;
    std::unique_ptr<RemotePort> openRemote(std::string_view name) override;

private:
    class FakeLocal;
    class FakeRemote;

    std::map<std::string, FakeLocal*> _locals;
    std::set<FakeRemote*> _remotes;
};

class FakePorts::FakeLocal final : public LocalPort {
public:
    FakeLocal(FakePorts& ports, std::string name, MessageCallback callback)
        : _ports(ports), _name(std::move(name)), _callback(std::move(callback)) {
        _ports._locals[_name] = this;
    }
    ~FakeLocal() override { close(); }

    void setInvalidationCallback(std::function<void(LocalPort&)> callback) override {
        _invalidated = std::move(callback);
    }
    void schedule() override { _scheduled = true; }
    void invalidate() override {
        if (!_valid) return;
        close();
        const auto callback = std::exchange(_invalidated, nullptr);
        if (callback) callback(*this);  // may have destroyed this port
    }
    bool isValid() const override { return _valid; }
    const std::string& name() const override { return _name; }

    std::optional<Bytes> deliver(std::int32_t id, const Bytes& data) {
        if (!_scheduled) return std::nullopt;
        return MessageCallback(_callback)(id, data);
    }

private:
    void close() {
        if (std::exchange(_valid, false)) _ports._locals.erase(_name);
    }

    FakePorts& _ports;
    const std::string _name;
    MessageCallback _callback;
    std::function<void(LocalPort&)> _invalidated;
    bool _valid = true;
    bool _scheduled = false;
};

class FakePorts::FakeRemote final : public RemotePort {
public:
    FakeRemote(FakePorts& ports, std::string name) : _ports(ports), _name(std::move(name)) {
        _ports._remotes.insert(this);
    }
    ~FakeRemote() override { close(); }

    Answer request(std::int32_t id, ByteView data, std::chrono::nanoseconds sendLimit,
                   std::optional<std::chrono::nanoseconds> replyLimit) override {
        if (!_valid) return Error::Invalid;
        _ports.sent.push_back({_name, id, Bytes(data.begin(), data.end()), sendLimit, replyLimit});
        const Sent message = _ports.sent.back();
        return _ports.onRequest(message);
    }
    bool isValid() const override { return _valid; }
    void invalidate() override {
        if (!_valid) return;
        close();
        const auto callback = std::exchange(_invalidated, nullptr);
        if (callback) callback(*this);
    }
    void setInvalidationCallback(std::function<void(RemotePort&)> callback) override {
        _invalidated = std::move(callback);
    }
    void notifyWhenWritable(std::function<void()>) override {}  // a fake port never fills up

private:
    void close() {
        if (std::exchange(_valid, false)) _ports._remotes.erase(this);
    }

    FakePorts& _ports;
    const std::string _name;
    std::function<void(RemotePort&)> _invalidated;
    bool _valid = true;
};

inline std::optional<Bytes> FakePorts::deliver(const std::string& name, std::int32_t id, const Bytes& data) {
    const auto found = _locals.find(name);
    return found != _locals.end() ? found->second->deliver(id, data) : std::nullopt;
}

inline void FakePorts::killPeer() {
    listening.clear();
    while (!_remotes.empty()) (*_remotes.begin())->invalidate();
}

inline LocalPort* FakePorts::local(const std::string& name) const {
    const auto found = _locals.find(name);
    return found != _locals.end() ? found->second : nullptr;
}

inline MessagePorts::Local FakePorts::createLocal(std::string_view name, MessageCallback callback) {
    if (refusesLocalPorts) return {};
    std::string text(name);
    if (taken.contains(text) || _locals.contains(text)) return {.port = nullptr, .alreadyExisted = true};
    return {.port = std::make_unique<FakeLocal>(*this, std::move(text), std::move(callback))};
}

inline std::unique_ptr<RemotePort> FakePorts::openRemote(std::string_view name) {
    std::string text(name);
    if (!listening.contains(text)) return nullptr;
    return std::make_unique<FakeRemote>(*this, std::move(text));
}

}  // namespace kelvo::test
