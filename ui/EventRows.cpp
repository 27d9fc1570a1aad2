#include "ui/EventRows.h"

#include <QStringList>
#include <algorithm>

#include "overview/Words.h"
#include "platform/system/Environment.h"
#include "ui/DateFormatter.h"

namespace kelvo {
namespace {

using overview::Event;

QString shown(std::string_view text) { return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())); }

bool isSame(const Event& one, const Event& other) {
    return one.time == other.time && one.kind == other.kind && one.from == other.from && one.to == other.to;
}

QString timeOf(const Event& event) {
    static const DateFormatter kTime(QStringLiteral("HH:mm:ss"));
    return kTime.stringFromDate(event.time);
}

/// Empty for today.
QString dayOf(const Event& event) {
    static const DateFormatter kDay(QStringLiteral("yyyy-MM-dd"));
    const QString day = kDay.stringFromDate(event.time);
    return day == kDay.stringFromDate(clock().now()) ? QString() : day;
}

QString titleOf(const Event& event) {
    QString name = shown(nameOf(event.kind));
    name[0] = name[0].toUpper();
    return name;
}

QString changed(const std::string& from, const std::string& to) {
    return QString::fromStdString(overview::changeText(from, to, "→"));
}

QString spokenChange(const std::string& from, const std::string& to) {
    return from.empty() || to.empty() ? shown(from + to) : QStringLiteral("from %1 to %2").arg(shown(from), shown(to));
}

/// One after the other as a person would tell it.
QString sentenceOf(const Event& event) {
    QStringList parts;
    if (const QString day = dayOf(event); !day.isEmpty()) parts.append(day);
    parts.append(timeOf(event));
    parts.append(titleOf(event));
    parts.append(spokenChange(event.from, event.to));
    parts.append(spokenChange(event.levelBefore, event.levelAfter));
    parts.removeAll(QString());
    return parts.join(QStringLiteral(", "));
}

QStringList textsOf(const Event& event, std::string overview::EventValue::*text) {
    QStringList texts;
    for (const overview::EventValue& value : event.values) texts.append(shown(value.*text));
    return texts;
}

}  // namespace

std::size_t EventRows::newerThanShown(const std::deque<Event>& events) const {
    if (_rows.empty()) return events.size();
    const auto newest = std::find_if(events.rbegin(), events.rend(),
                                     [this](const Event& event) { return isSame(event, _rows.front().event); });
    return static_cast<std::size_t>(newest - events.rbegin());
}

void EventRows::update(const std::deque<Event>& events) {
    const bool hadOpen = hasOpen();
    addNewer(events, newerThanShown(events));
    dropOlder(std::min(_most, events.size()));
    addOlder(events);
    fillIn(events);
    if (events.size() != _known) {
        _known = events.size();
        Q_EMIT countChanged();
    }
    if (hadOpen != hasOpen()) Q_EMIT openChanged();
}

void EventRows::beginAnew() {
    closeAll();
    _most = kFirst;
    dropOlder(_most);
    Q_EMIT countChanged();
}

void EventRows::showMore(const std::deque<Event>& events) {
    _most += kMore;
    addOlder(events);
    Q_EMIT countChanged();
}

void EventRows::addNewer(const std::deque<Event>& events, std::size_t count) {
    count = std::min(count, _most);
    const std::size_t added = std::min(count, _most - std::min(_most, _rows.size()));
    if (added > 0) {
        beginInsertRows({}, 0, static_cast<int>(added) - 1);
        const std::size_t first = events.size() - count;
        for (std::size_t i = first; i < first + added; ++i) _rows.push_front({events[i]});
        endInsertRows();
    }
    if (count > added) reuseOldest(events, count - added);
}

/// Of a full list the oldest rows become the newest: to make a row anew costs the view more than all else in a refresh.
void EventRows::reuseOldest(const std::deque<Event>& events, std::size_t count) {
    for (std::size_t row = _rows.size() - count; row < _rows.size(); ++row) setOpen(row, false);
    if (count < _rows.size()) {
        const int first = this->count() - static_cast<int>(count);
        beginMoveRows({}, first, this->count() - 1, {}, 0);
        std::rotate(_rows.begin(), _rows.begin() + first, _rows.end());
        endMoveRows();
    }
    for (std::size_t row = 0; row < count; ++row) _rows[row].event = events[events.size() - 1 - row];
    Q_EMIT dataChanged(index(0), index(static_cast<int>(count) - 1));
}

void EventRows::dropOlder(std::size_t most) {
    if (_rows.size() <= most) return;
    beginRemoveRows({}, static_cast<int>(most), count() - 1);
    _rows.resize(most);
    endRemoveRows();
}

void EventRows::addOlder(const std::deque<Event>& events) {
    const std::size_t wanted = std::min(_most, events.size());
    if (_rows.size() >= wanted) return;
    beginInsertRows({}, count(), static_cast<int>(wanted) - 1);
    while (_rows.size() < wanted) _rows.push_back({events[events.size() - 1 - _rows.size()]});
    endInsertRows();
}

/// A new cell's first level comes after the event.
void EventRows::fillIn(const std::deque<Event>& events) {
    for (std::size_t row = 0; row < _rows.size(); ++row) {
        Event& known = _rows[row].event;
        const Event& event = events[events.size() - 1 - row];
        if (known.levelAfter == event.levelAfter && known.values == event.values) continue;
        known = event;
        const QModelIndex at = index(static_cast<int>(row));
        Q_EMIT dataChanged(at, at, {LevelsRole, OpensRole, NamesRole, BeforeRole, AfterRole, SentenceRole});
    }
}

bool EventRows::hasOpen() const { return std::ranges::any_of(_rows, &Row::isOpen); }

void EventRows::setOpen(std::size_t row, bool open) {
    if (_rows[row].isOpen == open) return;
    _rows[row].isOpen = open;
    const QModelIndex at = index(static_cast<int>(row));
    Q_EMIT dataChanged(at, at, {IsOpenRole});
}

void EventRows::toggle(int row) {
    if (row < 0 || row >= count()) return;
    const auto wanted = static_cast<std::size_t>(row);
    const bool open = !_rows[wanted].isOpen && !_rows[wanted].event.values.empty();
    for (std::size_t each = 0; each < _rows.size(); ++each) setOpen(each, open && each == wanted);
    Q_EMIT openChanged();
}

bool EventRows::closeAll() {
    const bool hadOpen = hasOpen();
    for (std::size_t row = 0; row < _rows.size(); ++row) setOpen(row, false);
    if (hadOpen) Q_EMIT openChanged();
    return hadOpen;
}

QVariant EventRows::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= count()) return {};
    const Row& row = _rows[static_cast<std::size_t>(index.row())];
    const Event& event = row.event;
    switch (role) {
        case TimeRole: return timeOf(event);
        case DayRole: return dayOf(event);
        case TitleRole: return titleOf(event);
        case WhatRole: return changed(event.from, event.to);
        case LevelsRole: return changed(event.levelBefore, event.levelAfter);
        case OpensRole: return !event.values.empty();
        case IsOpenRole: return row.isOpen;
        case NamesRole: return textsOf(event, &overview::EventValue::name);
        case BeforeRole: return textsOf(event, &overview::EventValue::before);
        case AfterRole: return textsOf(event, &overview::EventValue::after);
        case SentenceRole: return sentenceOf(event);
        default: return {};
    }
}

QHash<int, QByteArray> EventRows::roleNames() const {
    return {{TimeRole, "time"},     {DayRole, "day"},     {TitleRole, "title"},      {WhatRole, "what"},
            {LevelsRole, "levels"}, {OpensRole, "opens"}, {IsOpenRole, "isOpen"},    {NamesRole, "names"},
            {BeforeRole, "before"}, {AfterRole, "after"}, {SentenceRole, "sentence"}};
}

}  // namespace kelvo
