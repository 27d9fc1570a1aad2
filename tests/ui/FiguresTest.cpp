#include "ui/Figures.h"

#include <gtest/gtest.h>

#include "ui/FigureLayout.h"

namespace kelvo {
namespace {

/// Every letter is as wide as `letter`, every digit as wide as its place in `digits`.
Figures::Advance font(qreal letter, const std::vector<qreal>& digits) {
    return [letter, digits](const QString& text) {
        qreal width = 0;
        for (const QChar c : text) width += c.isDigit() ? digits.at(static_cast<std::size_t>(c.digitValue())) : letter;
        return width;
    };
}

// The 1 is half as wide as the others, as in many proportional fonts; the 4 is the widest.
const std::vector<qreal> kUnequal = {8, 4, 8, 8, 10, 8, 8, 8, 8, 8};

TEST(Figures, LeavesATextInOnePieceWhenAllDigitsAreEquallyWide) {
    const Figures figures(font(6, std::vector<qreal>(10, 9)));
    EXPECT_EQ(figures.pieces(QStringLiteral("-95.50 dBm")),
              (std::vector<Figures::Piece>{{QStringLiteral("-95.50 dBm"), 0}}));
    EXPECT_EQ(figures.width(QStringLiteral("-95.50 dBm")), 4 * 9 + 6 * 6);
}

TEST(Figures, PutsUnequalDigitsIntoTheMiddleOfEqualCells) {
    const Figures figures(font(6, kUnequal));
    EXPECT_EQ(figures.pieces(QStringLiteral("-14 dB")), (std::vector<Figures::Piece>{{QStringLiteral("-"), 0},
                                                                                     {QStringLiteral("1"), 6 + 3},
                                                                                     {QStringLiteral("4"), 16},
                                                                                     {QStringLiteral(" dB"), 26}}));
}

TEST(Figures, KeepsTheWidthOfATextWhoseDigitsChange) {
    const Figures figures(font(6, kUnequal));
    const qreal width = figures.width(QStringLiteral("-111.11 dBm"));
    EXPECT_EQ(figures.width(QStringLiteral("-104.47 dBm")), width);
    EXPECT_EQ(figures.width(QStringLiteral("-98.00 dBm")), width - 10);
}

TEST(Figures, HasNoPiecesForAnEmptyText) {
    const Figures figures(font(6, kUnequal));
    EXPECT_TRUE(figures.pieces(QString()).empty());
    EXPECT_EQ(figures.width(QString()), 0);
}

TEST(Figures, EndsATextThatDoesNotFitWithAnEllipsis) {
    const Figures figures(font(10, std::vector<qreal>(10, 10)));
    EXPECT_EQ(figures.elided(QStringLiteral("Updated"), 70), QStringLiteral("Updated"));
    EXPECT_EQ(figures.elided(QStringLiteral("Updated"), 69), QStringLiteral("Updat\u2026"));
    EXPECT_EQ(figures.elided(QStringLiteral("Updated at 9"), 99), QStringLiteral("Updated\u2026"));
    EXPECT_EQ(figures.elided(QStringLiteral("Updated"), 1), QStringLiteral("\u2026"));
}

TEST(FigureLayout, LaysItsTextOutAnewWhenItChanges) {
    FigureLayout layout;
    layout.setText(QStringLiteral("-95 dBm"));
    EXPECT_EQ(layout.texts().join(QString()), QStringLiteral("-95 dBm"));
    EXPECT_EQ(layout.count(), layout.positions().size());
    const qreal width = layout.width();
    layout.setText(QStringLiteral("-11 dBm"));
    EXPECT_EQ(layout.width(), width);
    layout.setMaximumWidth(width / 2);
    EXPECT_LE(layout.width(), width / 2);
    EXPECT_TRUE(layout.texts().join(QString()).endsWith(QStringLiteral("\u2026")));
}

}  // namespace
}  // namespace kelvo
