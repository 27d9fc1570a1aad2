#pragma once

#include <QtQml/qqmlregistration.h>
#include <QAbstractListModel>
#include <deque>

#include "overview/Event.h"

namespace kelvo {

/// What happened, newest first; one row at a time may be open and show the values before and after. The list begins
/// short and is made longer on request. Main thread only.
class EventRows : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its rows")
    Q_PROPERTY(int count READ count NOTIFY countChanged)
    Q_PROPERTY(bool hasMore READ hasMore NOTIFY countChanged)
    Q_PROPERTY(bool hasOpen READ hasOpen NOTIFY openChanged)
public:
    static constexpr std::size_t kFirst = 20;  ///< rows, and so many more at a time
    static constexpr std::size_t kMore = 50;

    /// In QML: time, day, title, what, levels, opens, isOpen, names, before, after, sentence.
    enum Role {
        TimeRole = Qt::UserRole + 1,
        DayRole,     ///< empty for today
        TitleRole,   ///< "Handover"
        WhatRole,    ///< from where to where
        LevelsRole,  ///< of a change of cell, before and after
        OpensRole,   ///< there are values to show
        IsOpenRole,
        NamesRole,  ///< of the values, and what they were before and after
        BeforeRole,
        AfterRole,
        SentenceRole,
    };

    /// Takes up what `events` have now, which are oldest first: new ones, and values that were filled in.
    void update(const std::deque<overview::Event>& events);

    int count() const { return static_cast<int>(_rows.size()); }
    bool hasMore() const { return _rows.size() < _known; }
    bool hasOpen() const;
    /// As few rows as in the beginning, and none open.
    void beginAnew();
    /// Shows what `update` left out.
    void showMore(const std::deque<overview::Event>& events);

    /// Opens the row, or closes it when it is open.
    Q_INVOKABLE void toggle(int row);
    /// False when no row was open.
    Q_INVOKABLE bool closeAll();

    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : count(); }
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

Q_SIGNALS:
    void countChanged();
    void openChanged();

private:
    struct Row {
        overview::Event event;
        bool isOpen = false;
    };
    using Rows = std::deque<Row>;

    std::size_t newerThanShown(const std::deque<overview::Event>& events) const;
    void addNewer(const std::deque<overview::Event>& events, std::size_t count);
    void reuseOldest(const std::deque<overview::Event>& events, std::size_t count);
    void addOlder(const std::deque<overview::Event>& events);
    void dropOlder(std::size_t most);
    void fillIn(const std::deque<overview::Event>& events);
    void setOpen(std::size_t row, bool open);

    Rows _rows;  // newest first
    std::size_t _known = 0;
    std::size_t _most = kFirst;
};

}  // namespace kelvo
