#include "ui/TextMeasure.h"

#include <QFontMetricsF>
#include <QGuiApplication>
#include <cmath>

namespace kelvo {
namespace {

class SystemTextMeasure final : public TextMeasure {
public:
    QSizeF boldSize(const QString& text) const override {
        QFont font = QGuiApplication::font();
        font.setPixelSize(15);
        font.setBold(true);
        const QFontMetricsF metrics(font);
        return {std::ceil(metrics.horizontalAdvance(text)), std::ceil(metrics.height())};
    }
};

}  // namespace

const TextMeasure& TextMeasure::system() {
    static const SystemTextMeasure kMeasure;
    return kMeasure;
}

}  // namespace kelvo
