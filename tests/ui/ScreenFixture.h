#pragma once

#include <gtest/gtest.h>

#include <QQuickItem>
#include <QVariant>
#include <fstream>
#include <iterator>

#include "tests/ui/Scene.h"

namespace kelvo::test {

inline QString text(const char* latin1) { return QString::fromLatin1(latin1); }

/// A scene that is connected and shows the sample tree with three neighbors.
class ScreenFixture : public testing::Test {
protected:
    Scene& start(bool savingPermitted = false, QSize size = {360, 640}) {
        scene = std::make_unique<Scene>(savingPermitted, size);
        scene->connect();
        scene->show(sampleTree(3));
        scene->settle();
        return *scene;
    }
    /// Shows 30 branches above 30 leaves and scrolls to the last leaf, in rows that showed branches before. The list.
    QQuickItem* startWithRecycledRows() {
        start();
        const DictionaryRef display = Dictionary::make();
        for (int row = 0; row < 30; ++row) display->set("Branch " + std::to_string(row), Array::make());
        for (int row = 0; row < 30; ++row) display->set("Leaf " + std::to_string(row), "value");
        scene->show(display);
        QQuickItem* list = scene->itemOfType("QQuickListView");
        for (int y = 0; y <= 2400; y += 100) {
            list->setProperty("contentY", y);
            scene->settle();
        }
        return list;
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
    /// What the keyboard is on, by its text: a button's own, a field's placeholder; empty for anything else.
    QString focused() {
        const QQuickItem* item = scene->view().activeFocusItem();
        if (item == nullptr) return {};
        const QVariant placeholder = item->property("placeholderText");
        return placeholder.isValid() ? placeholder.toString() : item->property("text").toString();
    }
    /// Presses Tab until the keyboard is on the button or field of that text; fails the test when it never is.
    void tabTo(const char* name) {
        for (int presses = 0; presses < 5 && focused() != text(name); ++presses) scene->press(Qt::Key_Tab);
        EXPECT_EQ(focused(), text(name));
    }
    /// The part of a row that scrolls sideways.
    QQuickItem* strip(const QString& key) { return scene->row(key)->findChild<QQuickItem*>(text("strip")); }
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
