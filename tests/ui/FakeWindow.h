#pragma once

#include <string>
#include <utility>
#include <vector>

#include "platform/system/Preferences.h"
#include "ui/Window.h"

namespace kelvo::test {

/// What happened, in order.
using Events = std::vector<std::string>;

/// A window without a screen that notes what is done to it.
class FakeWindow final : public Window {
public:
    explicit FakeWindow(Events& events) : _events(events) { _events.push_back("window created"); }
    ~FakeWindow() override { _events.push_back("window destroyed"); }

    void setRootScreen(KelvoApp&) override { _events.push_back("root screen set"); }
    void makeKeyAndVisible() override { _events.push_back("window shown"); }
    void orderOut() override { _events.push_back("window off screen"); }

private:
    Events& _events;
};

/// Preferences that keep nothing and note what is written.
class FakePreferences final : public Preferences {
public:
    explicit FakePreferences(Events& events) : _events(events) {}

    bool writable = true;

    bool set(std::string_view domain, std::string_view key, const Value& value) override {
        const std::string text = value.boolean() == nullptr ? "?" : *value.boolean() ? "true" : "false";
        _events.push_back("set " + std::string(domain) + " " + std::string(key) + " " + text);
        return writable;
    }
    void broadcastChange(std::string_view domain, std::string_view key) override {
        _events.push_back("broadcast " + std::string(domain) + " " + std::string(key));
    }

private:
    Events& _events;
};

}  // namespace kelvo::test
