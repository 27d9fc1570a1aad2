#pragma once

#include <QSizeF>
#include <QString>

namespace kelvo {

/// Measures row texts in the bold 15-point font, every digit as wide as the widest; points are device-independent
/// pixels.
class TextMeasure {
public:
    virtual ~TextMeasure() = default;
    virtual QSizeF boldSize(const QString& text) const = 0;

    /// The system font's. Sizes are whole pixels, so that texts stand on whole pixels. Needs a QGuiApplication.
    static const TextMeasure& system();
};

}  // namespace kelvo
