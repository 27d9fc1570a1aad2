#include "ui/TextMeasure.h"

#include <QFontMetricsF>
#include <QGuiApplication>
#include <cmath>
#include <optional>

#include "ui/Figures.h"

namespace kelvo {
namespace {

class SystemTextMeasure final : public TextMeasure {
public:
    QSizeF boldSize(const QString& text) const override {
        useFont(QGuiApplication::font());
        return {std::ceil(_figures->width(text)), _height};
    }

private:
    void useFont(QFont font) const {
        font.setPixelSize(15);
        font.setBold(true);
        if (_figures && font == _font) return;
        _font = font;
        _figures.emplace(font);
        _height = std::ceil(QFontMetricsF(font).height());
    }

    mutable QFont _font;  // the one that was measured with last
    mutable std::optional<Figures> _figures;
    mutable qreal _height = 0;
};

}  // namespace

const TextMeasure& TextMeasure::system() {
    static const SystemTextMeasure kMeasure;
    return kMeasure;
}

}  // namespace kelvo
