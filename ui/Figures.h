#pragma once

#include <QFont>
#include <QString>
#include <array>
#include <functional>
#include <vector>

namespace kelvo {

/// Sets texts so that every digit takes the room of the widest one: a value whose digits change keeps its width and its
/// place. Most fonts draw such digits by themselves, and then a text stays in one piece; where a font's digits differ,
/// each stands in the middle of a cell of its own.
class Figures {
public:
    struct Piece {
        QString text;
        qreal x;  ///< from the text's left edge
        friend bool operator==(const Piece&, const Piece&) = default;
    };
    using Advance = std::function<qreal(const QString&)>;  ///< a text's natural width

    explicit Figures(const QFont& font);
    explicit Figures(Advance advance);

    /// Left to right; none for an empty text.
    std::vector<Piece> pieces(const QString& text) const;
    qreal width(const QString& text) const;
    /// `text`, or as much of its beginning as fits into `width` with an ellipsis behind it.
    QString elided(const QString& text, qreal width) const;

private:
    /// Where `text` ends when it is set in pieces; calls `place` with each.
    qreal set(const QString& text, const std::function<void(QString, qreal)>& place) const;

    Advance _advance;
    std::array<qreal, 10> _digits{};
    qreal _cell = 0;
    bool _tabular = true;
};

}  // namespace kelvo
