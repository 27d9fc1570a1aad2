#include "ui/OverviewController.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "model/TrendWords.h"
#include "overview/Words.h"

namespace kelvo {
namespace {

using overview::Fact;
using overview::Measure;
using overview::TrackedCell;

QString shown(const std::string& text) { return QString::fromStdString(text); }

QString textOf(const std::optional<Measure>& measure) { return measure ? shown(measure->figure.text) : QString(); }

QString named(const std::optional<Measure>& measure) {
    return measure ? shown(measure->name + " " + measure->figure.text) : QString();
}

/// For ones who hear it: a sign is easily missed.
QString comparison(const std::optional<Measure>& level, const std::optional<Measure>& serving) {
    if (differenceText(level, serving).empty()) return {};
    const double difference = level->figure.number - serving->figure.number;
    if (difference == 0) return QStringLiteral("as strong as the serving cell");
    return QStringLiteral("%1%2 %3 than the serving cell")
        .arg(shown(numberText(std::abs(difference))), level->figure.unit.empty() ? QString() : QStringLiteral(" dB"),
             difference > 0 ? QStringLiteral("stronger") : QStringLiteral("weaker"));
}

QStringList rowOf(const TrackedCell& cell, const std::optional<Measure>& serving, overview::Time now) {
    const QString identity = shown(cell.heard.identity);
    const QString age = shown(overview::ageText(cell.lastHeard, now));
    const QString mark = cell.isLost ? QStringLiteral("lost") : shown(cell.heard.mark);
    QStringList sentence = {identity,
                            mark,
                            named(cell.heard.level),
                            named(cell.heard.quality),
                            comparison(cell.heard.level, serving),
                            QStringLiteral("heard %1").arg(age)};
    sentence.removeAll(QString());
    return {identity,
            textOf(cell.heard.level),
            textOf(cell.heard.quality),
            shown(differenceText(cell.heard.level, serving)),
            age,
            mark,
            sentence.join(QStringLiteral(", "))};
}

}  // namespace

void OverviewController::refreshed() {
    _isFresh = true;
    _live.refreshed();
    reload();
}

void OverviewController::connectionChanged() {
    _live.connectionChanged();
    reload();
}

void OverviewController::letPass() {
    if (std::exchange(_isFresh, false)) return;  // the refresh has told how old everything is
    _live.letPass();
    reload();
}

void OverviewController::setOpen(bool open) {
    if (_isOpen == open) return;
    _isOpen = open;
    Q_EMIT openChanged();
}

void OverviewController::setWatched(bool watched) {
    if (_isWatched == watched) return;
    _isWatched = watched;
    if (!watched) _events.beginAnew();
    reload();
    Q_EMIT watchedChanged();
}

void OverviewController::reload() {
    if (!_isWatched) return;
    const overview::Tracker& tracker = _live.tracker();
    const overview::Observation& seen = tracker.latest();
    if (!seen.access.empty() && seen.access != _access) beginRadio(seen.access);
    reloadServing(seen);
    reloadCells(tracker);
    keepPlaces(_registrationFacts, seen.registration);
    showFacts(_registration, _registrationFacts);
    Facts data;
    for (const overview::Context& context : seen.contexts) data.push_back({context.name, context.text});
    data.insert(data.end(), seen.rates.begin(), seen.rates.end());
    showFacts(_data, data);
    _events.update(tracker.events());
    Q_EMIT changed();
}

void OverviewController::beginRadio(const std::string& access) {
    _access = access;
    _isCellKnown = false;
    _cellsHave = {};
    _servingFacts.clear();
    _registrationFacts.clear();
    _level.forget();
    _quality.forget();
    Q_EMIT columnsChanged();
    for (TextRows* rows : {&_serving, &_cells, &_registration, &_data}) rows->clear();
}

void OverviewController::reloadServing(const overview::Observation& seen) {
    const overview::Tracker& tracker = _live.tracker();
    const overview::Time now = _live.now();
    _title = seen.access.empty() ? QStringLiteral("No serving cell") : shown(seen.access);
    _state = shown(seen.state);
    _isCellKnown = _isCellKnown || !seen.cell.empty();
    _cell = seen.cell.empty() ? QStringLiteral("–") : shown(seen.cell);
    _level.show({seen.level, tracker.levelTime(), now});
    _level.showLine(_live.level(), _live.servingCells(), _live.lineTime());
    _quality.show({seen.quality, tracker.qualityTime(), now});
    _quality.showLine(_live.quality(), _live.servingCells(), _live.lineTime());
    Facts facts;
    if (!seen.area.empty()) facts.push_back({"Area", seen.area});
    facts.insert(facts.end(), seen.serving.begin(), seen.serving.end());
    keepPlaces(_servingFacts, facts);
    showFacts(_serving, _servingFacts);
}

void OverviewController::reloadCells(const overview::Tracker& tracker) {
    const std::optional<Measure>& serving = tracker.latest().level;
    const overview::Time now = _live.now();
    const Columns before = _cellsHave;
    std::vector<QStringList> rows;
    rows.reserve(tracker.cells().size());
    for (const TrackedCell& cell : tracker.cells()) {
        _cellsHave.level = _cellsHave.level || cell.heard.level;
        _cellsHave.quality = _cellsHave.quality || cell.heard.quality;
        rows.push_back(rowOf(cell, serving, now));
        _cellsHave.difference = _cellsHave.difference || !rows.back()[3].isEmpty();
    }
    _cells.setRows(rows);
    if (_cellsHave != before) Q_EMIT columnsChanged();
}

/// Each fact stays in its place; one that is not told now is empty there. A new one comes behind the one that it is
/// told behind.
void OverviewController::keepPlaces(Facts& kept, const Facts& told) {
    for (Fact& fact : kept) fact.text.clear();
    auto place = kept.begin();
    for (const Fact& fact : told) {
        const auto isThere = [&](const Fact& other) { return other.name == fact.name && other.text.empty(); };
        const auto known = std::find_if(kept.begin(), kept.end(), isThere);
        if (known != kept.end()) known->text = fact.text;
        place = std::next(known != kept.end() ? known : kept.insert(place, fact));
    }
}

void OverviewController::showFacts(TextRows& rows, const Facts& facts) {
    std::vector<QStringList> texts;
    texts.reserve(facts.size());
    for (const Fact& fact : facts) {
        const QString name = shown(fact.name);
        const QString text = shown(fact.text);
        const bool isTold = !text.isEmpty();
        texts.push_back({name, isTold ? text : QStringLiteral("–"),
                         isTold ? name + QStringLiteral(", ") + text : QStringLiteral("%1 not reported").arg(name)});
    }
    rows.setRows(texts);
}

}  // namespace kelvo
