#pragma once

#include <QtQml/qqmlregistration.h>
#include <QObject>
#include <QString>
#include <vector>

#include "overview/LiveOverview.h"
#include "ui/EventRows.h"
#include "ui/OverviewMeasure.h"
#include "ui/TextRows.h"

namespace kelvo {

/// The overview: the values of the screens put together at a glance. It follows the model as long as the application
/// runs, and words what it knows while a view shows it. What a radio has told once keeps its place on the screen, so
/// that nothing below moves when a value goes and comes again. Main thread only.
class OverviewController : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its overview")
    Q_PROPERTY(bool open READ isOpen NOTIFY openChanged)
    Q_PROPERTY(bool watched READ isWatched WRITE setWatched NOTIFY watchedChanged)
    Q_PROPERTY(QString title READ title NOTIFY changed)
    Q_PROPERTY(QString state READ state NOTIFY changed)
    Q_PROPERTY(QString cell READ cell NOTIFY changed)
    Q_PROPERTY(bool cellKnown READ isCellKnown NOTIFY changed)
    Q_PROPERTY(bool cellsHaveLevel READ cellsHaveLevel NOTIFY columnsChanged)
    Q_PROPERTY(bool cellsHaveQuality READ cellsHaveQuality NOTIFY columnsChanged)
    Q_PROPERTY(bool cellsHaveDifference READ cellsHaveDifference NOTIFY columnsChanged)
    Q_PROPERTY(kelvo::OverviewMeasure* level READ level CONSTANT)
    Q_PROPERTY(kelvo::OverviewMeasure* quality READ quality CONSTANT)
    Q_PROPERTY(kelvo::TextRows* serving READ serving CONSTANT)
    Q_PROPERTY(kelvo::TextRows* cells READ cells CONSTANT)
    Q_PROPERTY(kelvo::TextRows* registration READ registration CONSTANT)
    Q_PROPERTY(kelvo::TextRows* data READ data CONSTANT)
    Q_PROPERTY(kelvo::EventRows* events READ events CONSTANT)
public:
    /// The model outlives it.
    explicit OverviewController(const KelvoModel& model) : _live(model) {}

    // What the application tells of its model.
    void refreshed();
    void connectionChanged();
    void letPass();

    /// The reader is with the overview: on a phone it covers the panes.
    bool isOpen() const { return _isOpen; }
    Q_INVOKABLE void show() { setOpen(true); }
    Q_INVOKABLE void close() { setOpen(false); }
    /// A view shows it.
    bool isWatched() const { return _isWatched; }
    void setWatched(bool watched);

    const QString& title() const { return _title; }  ///< the radio
    const QString& state() const { return _state; }
    const QString& cell() const { return _cell; }             ///< a dash while none serves
    bool isCellKnown() const { return _isCellKnown; }         ///< one has served
    bool cellsHaveLevel() const { return _cellsHave.level; }  ///< one of the cells around, so far
    bool cellsHaveQuality() const { return _cellsHave.quality; }
    bool cellsHaveDifference() const { return _cellsHave.difference; }
    OverviewMeasure* level() { return &_level; }
    OverviewMeasure* quality() { return &_quality; }
    TextRows* serving() { return &_serving; }            ///< name, text, sentence
    TextRows* cells() { return &_cells; }                ///< identity, level, quality, difference, age, mark, sentence
    TextRows* registration() { return &_registration; }  ///< as `serving`
    TextRows* data() { return &_data; }                  ///< contexts and rates, as `serving`
    EventRows* events() { return &_events; }
    Q_INVOKABLE void showMoreEvents() { _events.showMore(_live.tracker().events()); }

Q_SIGNALS:
    void openChanged();
    void watchedChanged();
    void changed();
    void columnsChanged();

private:
    using Facts = std::vector<overview::Fact>;
    struct Columns {
        bool level = false;
        bool quality = false;
        bool difference = false;
        bool operator==(const Columns&) const = default;
    };

    void setOpen(bool open);
    void reload();
    void beginRadio(const std::string& access);
    void reloadServing(const overview::Observation& seen);
    void reloadCells(const overview::Tracker& tracker);
    static void keepPlaces(Facts& kept, const Facts& told);
    static void showFacts(TextRows& rows, const Facts& facts);

    overview::LiveOverview _live;
    bool _isOpen = false;
    bool _isWatched = false;
    bool _isFresh = false;  // refreshed since time passed last
    std::string _access;    // whose places are kept
    QString _title;
    QString _state;
    QString _cell;
    bool _isCellKnown = false;
    Columns _cellsHave;
    Facts _servingFacts;
    Facts _registrationFacts;
    OverviewMeasure _level;
    OverviewMeasure _quality;
    TextRows _serving{{"name", "text", "sentence"}};
    TextRows _cells{{"identity", "level", "quality", "difference", "age", "mark", "sentence"}};
    TextRows _registration{{"name", "text", "sentence"}};
    TextRows _data{{"name", "text", "sentence"}};
    EventRows _events;
};

}  // namespace kelvo
