#pragma once

#include <gtest/gtest.h>

#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo::test {

/// A generator over the application's own template, its display built. KELVO_RESOURCE_DIR names the templates.
template <class Generator>
class TemplateScreens : public testing::Test {
protected:
    TemplateScreens() { generator.getDisplayFromState(state); }

    const DictionaryRef& screen(const char* name) { return (*state["Display"].dictionary())[name].dictionary(); }
    const ArrayRef& rows(const char* name) { return (*state["Display"].dictionary())[name].array(); }
    void feed(const Record& record) { generator.updateState(state, record.bytes()); }

    DirectoryResources resources{KELVO_RESOURCE_DIR};
    RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
    Dictionary state;
    Generator generator;
};

}  // namespace kelvo::test
