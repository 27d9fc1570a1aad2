#include "ui/QuickWindow.h"

#include <gtest/gtest.h>

#include <QScreen>

namespace kelvo {
namespace {

TEST(QuickWindow, OpensOverTheWholeOfAPhonesScreen) {
    EXPECT_EQ(QuickWindow::openingSize({360, 640}), QSize(360, 640));
    EXPECT_EQ(QuickWindow::openingSize({412, 915}), QSize(412, 915));
    EXPECT_EQ(QuickWindow::openingSize({915, 412}), QSize(915, 412));  // held sideways
    EXPECT_EQ(QuickWindow::openingSize({600, 960}), QSize(600, 960));
    EXPECT_EQ(QuickWindow::openingSize({960, 600}), QSize(960, 600));
}

TEST(QuickWindow, OpensAsLargeAsAPhoneOnADesk) {
    EXPECT_EQ(QuickWindow::openingSize({1920, 1080}), QSize(412, 732));
    EXPECT_EQ(QuickWindow::openingSize({700, 650}), QSize(412, 650));
    EXPECT_EQ(QuickWindow::openingSize({601, 960}), QSize(412, 732));
    EXPECT_EQ(QuickWindow::openingSize({960, 601}), QSize(412, 601));
}

TEST(QuickWindow, OpensAsItsScreenAllows) {
    QuickWindow window;
    EXPECT_EQ(window.view().size(), QuickWindow::openingSize(window.view().screen()->availableSize()));
}

}  // namespace
}  // namespace kelvo
