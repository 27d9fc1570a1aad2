#include "ui/KelvoCell.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

/// Texts as wide as their number says: "key 120" is 120 by 18.
class StatedWidths final : public TextMeasure {
public:
    QSizeF boldSize(const QString& text) const override { return {text.section(QLatin1Char(' '), 1).toDouble(), 18}; }
};

class Cell : public testing::Test {
protected:
    /// A row that first shows a child with children, or a leaf.
    std::unique_ptr<KelvoCell> make(bool opens, const char* key, const char* value, QRectF area = {0, 0, 320, 50}) {
        auto cell = std::make_unique<KelvoCell>(measure);
        show(*cell, opens, key, value);
        cell->setContentArea(area);
        cell->componentComplete();
        return cell;
    }
    static void show(KelvoCell& cell, bool opens, const char* key, const char* value) {
        cell.setKey(QLatin1String(key));
        cell.setValue(QLatin1String(value));
        cell.setOpens(opens);
    }

    StatedWidths measure;
};

TEST_F(Cell, PutsTheKeyTenPointsInAndInTheMiddle) {
    const auto cell = make(true, "key 120", "");
    EXPECT_EQ(cell->keyFrame(), QRectF(10, 16, 120, 18));
}

TEST_F(Cell, PutsALongValueFiftyPointsBehindItsKeyAndScrolls) {
    const auto cell = make(false, "key 120", "value 200");
    EXPECT_EQ(cell->keyFrame(), QRectF(10, 16, 120, 18));
    EXPECT_EQ(cell->valueFrame(), QRectF(180, 16, 200, 18));
    EXPECT_EQ(cell->viewContentSize(), QSizeF(640, 50));
    EXPECT_EQ(cell->viewFrame(), QRectF(0, 0, 320, 50));
}

TEST_F(Cell, PutsAShortValueFlushAgainstTheRightEdge) {
    const auto cell = make(false, "key 120", "value 100");
    EXPECT_EQ(cell->valueFrame(), QRectF(220, 16, 100, 18));
    EXPECT_EQ(cell->viewContentSize(), QSizeF(320, 50));
}

TEST_F(Cell, NeitherAlignsRightNorScrollsAValueThatFitsExactly) {
    const auto cell = make(false, "key 120", "value 140");  // 120 + 10 + 50 + 140 = 320
    EXPECT_EQ(cell->valueFrame(), QRectF(180, 16, 140, 18));
    EXPECT_EQ(cell->viewContentSize(), QSizeF(320, 50));
}

TEST_F(Cell, LaysOutWithinAContentAreaThatDoesNotStartAtZero) {
    const auto cell = make(false, "key 120", "value 200", {4, 2, 320, 60});
    EXPECT_EQ(cell->keyFrame(), QRectF(14, 21, 120, 18));
    EXPECT_EQ(cell->valueFrame(), QRectF(184, 21, 200, 18));
    EXPECT_EQ(cell->viewFrame(), QRectF(4, 2, 320, 50));  // fifty points high in a row of sixty
}

TEST_F(Cell, IsLaidOutAgainWhenItsValueChanges) {
    const auto cell = make(false, "key 120", "value 200");
    cell->setValue(QStringLiteral("value 100"));
    EXPECT_EQ(cell->shownValue(), QStringLiteral("value 100"));
    EXPECT_EQ(cell->valueFrame(), QRectF(220, 16, 100, 18));
    EXPECT_EQ(cell->viewContentSize(), QSizeF(320, 50));
}

TEST_F(Cell, OfAKeyHasNeitherValueNorStrip) {
    const auto cell = make(true, "key 120", "");
    EXPECT_EQ(cell->kind(), KelvoCell::Kind::Key);
    EXPECT_TRUE(cell->shownValue().isEmpty());
    EXPECT_TRUE(cell->viewFrame().isEmpty());
}

TEST_F(Cell, OfAKeyRecycledForALeafShowsTheNameOnly) {
    const auto cell = make(true, "key 120", "");
    show(*cell, false, "leaf 90", "value 50");
    EXPECT_EQ(cell->kind(), KelvoCell::Kind::Key);
    EXPECT_EQ(cell->keyFrame(), QRectF(10, 16, 90, 18));
    EXPECT_TRUE(cell->shownValue().isEmpty());
    EXPECT_TRUE(cell->viewFrame().isEmpty());
    EXPECT_EQ(cell->accessibleName(), QStringLiteral("leaf 90"));
}

TEST_F(Cell, OfAValueRecycledForAChildWithChildrenShowsNoValue) {
    const auto cell = make(false, "key 120", "value 50");
    show(*cell, true, "branch 90", "");
    EXPECT_EQ(cell->kind(), KelvoCell::Kind::Value);
    EXPECT_EQ(cell->keyFrame(), QRectF(10, 16, 90, 18));
    EXPECT_TRUE(cell->shownValue().isEmpty());
    show(*cell, false, "leaf 90", "value 60");
    EXPECT_EQ(cell->shownValue(), QStringLiteral("value 60"));
}

TEST_F(Cell, TellsAScreenReaderKeyAndValue) {
    EXPECT_EQ(make(false, "RSRP 40", "-95 60")->accessibleName(), QStringLiteral("RSRP 40, -95 60"));
}

TEST(TextMeasure, MeasuresInWholePixelsAndBold) {
    const QSizeF size = TextMeasure::system().boldSize(QStringLiteral("Measured RSRP"));
    EXPECT_EQ(size, QSizeF(size.toSize()));
    EXPECT_GT(size.width(), 60);
    EXPECT_GT(size.height(), 14);
}

}  // namespace
}  // namespace kelvo
