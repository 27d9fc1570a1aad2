#include "ui/DetailsController.h"

#include <QClipboard>
#include <QDateTime>
#include <QGuiApplication>
#include <algorithm>

#include "glossary/Glossary.h"
#include "model/LevelGrades.h"
#include "model/TrendWords.h"
#include "ui/DateFormatter.h"
#include "ui/RecordDump.h"
#include "ui/ScreenHost.h"
#include "ui/TrendCandidates.h"

namespace kelvo {
namespace {

QString shown(std::string_view text) { return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())); }

QString modemTimeText(SystemTime time) {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(time.time_since_epoch());
    return QDateTime::fromMSecsSinceEpoch(milliseconds.count(), Qt::UTC)
        .toString(QStringLiteral("'Modem time' yyyy-MM-dd HH:mm:ss.zzz 'UTC'"));
}

}  // namespace

DetailsController::DetailsController(const ShownValues& values, const std::string& path, int row, ScreenHost& host)
    : _values(values), _host(host), _row(row), _written(shown(values.savedText())) {
    const NodeRef node = values.shownNodeAtPath(path);
    const std::string leaf = node ? leafOf(*node, path) : path;
    _name = values.trends().nameAt(leaf);
    readMeaning(leaf);
    _title = shown(keyOfTrend(_name));
    _place = shown(placeOfTrend(_name));
    reload();
}

std::string DetailsController::leafOf(const KelvoModelNode& node, const std::string& path) const {
    if (node.childNodes() == nullptr) return path;
    std::string best = path;
    int bestRank = 0;
    for (const NodeRef& child : *node.childNodes()) {
        const std::string leaf = pathByAppending(path, child->displayName());
        const std::string name = _values.trends().nameAt(leaf);
        const Trend trend = _values.trends().trend(name);
        const int rank = !gradesOf(name, trend.unit).empty() ? 3 : !trend.unit.empty() ? 2 : 1;
        if (child->childNodes() != nullptr || rank <= bestRank) continue;
        best = leaf;
        bestRank = rank;
    }
    return best;
}

void DetailsController::reload() {
    const Trends& trends = _values.trends();
    const NodeRef node = _values.shownNodeAtPath(trends.pathOf(_name));
    if (node && node->value() != nullptr) {
        _valueText = QString::fromStdString(*node->value());
        readProvenance(*node);
    }
    _trend = trends.trend(_name);
    _comparison = _comparisonName.empty() ? Trend() : trends.trend(_comparisonName);
    _servingCells = trends.servingCells();
    _now = _values.trendTime();
    readChanges();
    Q_EMIT changed();
}

void DetailsController::readMeaning(const std::string& path) {
    const auto technology = _values.technology();
    const Meaning* meaning = technology ? meaningAt(*technology, path) : nullptr;
    if (meaning == nullptr) return;
    _meaning = shown(meaning->sentence);
    _standard = shown(standardOf(*meaning));
}

void DetailsController::readProvenance(const KelvoModelNode& node) {
    const auto from = _values.provenance(node);
    if (!from) return;  // what was known of the record is still true but for its age
    _written = QStringLiteral("%1 ago, by record %2")
                   .arg(QString::fromStdString(agoText(std::chrono::duration_cast<Trend::Time>(from->age))))
                   .arg(from->record);
    _record = QString::fromStdString(describe(*from));
    _modemTime = from->modemTime ? modemTimeText(*from->modemTime) : QString();
    // The bytes are there until the next record of their kind; what was shown of them stays true for this one.
    if (from->record == _recordNumber && from->bytes.empty()) return;
    _recordNumber = from->record;
    _dump = recordDump(from->bytes, from->place);
    _dumpWords = placeText(from->bytes, from->place);
}

void DetailsController::readChanges() {
    _changes.clear();
    if (hasTrend()) return;
    const std::vector<TrendChange> changes = _values.trends().changes(_name);
    const bool isSaved = !_values.savedText().empty();
    if (isSaved && changes.size() < 2) return;  // a saved value that stayed as it is has nothing to tell
    for (auto change = changes.rbegin(); change != changes.rend(); ++change)
        _changes.append(QString::fromStdString(change->text) + QStringLiteral(", ") + sinceText(change->at));
}

/// "since 12 seconds"; what was saved grows no older, and has the time of day: "from 09:15:00".
QString DetailsController::sinceText(Trend::Time at) const {
    if (_values.savedText().empty()) return QStringLiteral("since ") + QString::fromStdString(agoText(_now - at));
    return DateFormatter(QStringLiteral("'from' HH:mm:ss")).stringFromDate(Clock::TimePoint(at));
}

void DetailsController::findCandidates() {
    _candidates = trendCandidates(_values.trends(), _name);
    _candidateTitles.clear();
    _candidatePlaces.clear();
    for (const std::string& candidate : _candidates) {
        _candidateTitles.append(shown(keyOfTrend(candidate)));
        _candidatePlaces.append(shown(placeOfTrend(candidate)));
    }
    Q_EMIT candidatesChanged();
}

void DetailsController::compareWith(int candidate) {
    if (candidate < 0 || candidate >= _candidateTitles.size()) return;
    _comparisonName = _candidates[static_cast<std::size_t>(candidate)];
    _comparedWith = QStringLiteral("%1, %2").arg(_candidateTitles[candidate], _candidatePlaces[candidate]);
    Q_EMIT comparisonChanged();
    reload();
}

void DetailsController::stopComparing() {
    _comparisonName.clear();
    _comparedWith.clear();
    Q_EMIT comparisonChanged();
    reload();
}

void DetailsController::copyValue() { QGuiApplication::clipboard()->setText(_valueText); }

void DetailsController::close() { _host.closeDetails(); }

}  // namespace kelvo
