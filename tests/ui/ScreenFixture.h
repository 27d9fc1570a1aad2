#pragma once

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include "tests/ui/Scene.h"

namespace kelvo::test {

inline QString text(const char* latin1) { return QString::fromLatin1(latin1); }

/// A scene that is connected and shows the sample tree with three neighbours.
class ScreenFixture : public testing::Test {
protected:
    Scene& start(bool savingPermitted = false, QSize size = {360, 640}) {
        scene = std::make_unique<Scene>(savingPermitted, size);
        scene->connect();
        scene->show(sampleTree(3));
        scene->settle();
        return *scene;
    }
    std::size_t depth() { return scene->app().navigation()->viewControllers().size(); }
    void expectTop(const char* title) {
        scene->settle();
        EXPECT_EQ(scene->app().navigation()->topViewController().title(), text(title));
        EXPECT_TRUE(scene->shows(text(title)));
    }
    void openSheet() {
        scene->tapText(text("Save"));
        scene->settle();
        ASSERT_TRUE(scene->shows(text("Save Snapshot")));
    }
    std::vector<std::filesystem::path> savedFiles() {
        return {std::filesystem::directory_iterator(scene->snapshotDirectory()), std::filesystem::directory_iterator()};
    }
    std::string savedDescription() {
        std::ifstream file(savedFiles().at(0), std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
        return *(*readPropertyList(bytesOf(bytes))->dictionary())["Description"].string();
    }

    std::unique_ptr<Scene> scene;
};

}  // namespace kelvo::test
