#include "ui/OverviewMeasure.h"

#include <QStringList>
#include <algorithm>

#include "model/LevelGrades.h"
#include "model/TrendWords.h"
#include "overview/Words.h"
#include "ui/KelvoPaneController.h"

namespace kelvo {
namespace {

/// All figures have the same grades, from poor on.
int stepOf(const std::string& grade) {
    const std::span<const LevelGrade> grades = gradesOf(Graded::Rsrp);
    const auto at = std::ranges::find(grades, grade, &LevelGrade::name);
    return static_cast<int>(grades.end() - at);
}

/// "-95.25" of "-95.25 dBm".
QString withoutUnit(const overview::Figure& figure) {
    const QString text = QString::fromStdString(figure.text);
    const QString unit = QLatin1Char(' ') + QString::fromStdString(figure.unit);
    return !figure.unit.empty() && text.endsWith(unit) ? text.chopped(unit.size()) : text;
}

QString joined(QStringList parts) {
    parts.removeAll(QString());
    return parts.join(QStringLiteral(", "));
}

}  // namespace

void OverviewMeasure::show(const Shown& shown) {
    if (!shown.measure && !isKnown()) return;
    _age = shown.written ? QString::fromStdString(overview::ageText(*shown.written, shown.now)) : QString();
    _isOld = shown.written && shown.now - *shown.written >= KelvoPaneController::kOldFrom;
    if (shown.measure) {
        _name = QString::fromStdString(shown.measure->name);
        _number = withoutUnit(shown.measure->figure);
        _unit = QString::fromStdString(shown.measure->figure.unit);
        _grade = QString::fromStdString(shown.measure->grade);
        _isGraded = _isGraded || !_grade.isEmpty();
        _step = stepOf(shown.measure->grade);
        _sentence =
            joined({_name + QLatin1Char(' ') + QString::fromStdString(shown.measure->figure.text), _grade, _age});
    } else {
        _number = QStringLiteral("–");
        _unit = _grade = _age = QString();
        _step = 0;
        _sentence = QStringLiteral("%1 not reported").arg(_name);
    }
    Q_EMIT changed();
}

void OverviewMeasure::showLine(const overview::LiveOverview::Line& line, const std::deque<TrendChange>& servingCells,
                               Trend::Time now) {
    _lineEnd = now;
    _servingCells.assign(servingCells.begin(), servingCells.end());
    _lineUnit = line.unit;
    _line.unit = _lineUnit;
    _line.points.clear();
    for (const overview::LiveOverview::Point& point : line.points) {
        _line.points.push_back({.at = point.at, .number = point.number});
    }
    const Trend::Time from = now - overview::LiveOverview::kSpan;
    _summary = _line.points.empty() ? QString() : QString::fromStdString(trendSummary(_line, from, now, now));
    Q_EMIT lineChanged();
}

void OverviewMeasure::forget() {
    _name = _number = _unit = _grade = _age = _sentence = _summary = QString();
    _isGraded = false;
    _step = 0;
    _line = {};
    Q_EMIT changed();
    Q_EMIT lineChanged();
}

}  // namespace kelvo
