#pragma once

#include <QtQml/qqmlregistration.h>
#include <QObject>
#include <QString>
#include <deque>
#include <optional>
#include <vector>

#include "model/Trend.h"
#include "overview/LiveOverview.h"

namespace kelvo {

/// The serving cell's level or quality: the figure, its grade in words, its age, and how it has gone in the last two
/// minutes. Once seen it keeps its place, also while it is not told. Main thread only.
class OverviewMeasure : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its measures")
    Q_PROPERTY(bool known READ isKnown NOTIFY changed)
    Q_PROPERTY(QString name READ name NOTIFY changed)
    Q_PROPERTY(QString number READ number NOTIFY changed)
    Q_PROPERTY(QString unit READ unit NOTIFY changed)
    Q_PROPERTY(QString grade READ grade NOTIFY changed)
    Q_PROPERTY(bool graded READ isGraded NOTIFY changed)
    Q_PROPERTY(int step READ step NOTIFY changed)
    Q_PROPERTY(QString age READ age NOTIFY changed)
    Q_PROPERTY(bool old READ isOld NOTIFY changed)
    Q_PROPERTY(QString sentence READ sentence NOTIFY changed)
    Q_PROPERTY(QString summary READ summary NOTIFY lineChanged)
public:
    static constexpr int kSteps = 4;  ///< excellent is the fourth, poor the first

    struct Shown {
        std::optional<overview::Measure> measure;
        std::optional<overview::Time> written;
        overview::Time now;
    };
    void show(const Shown& shown);
    /// `now` is the line's right end; upright lines tell where another cell began to serve.
    void showLine(const overview::LiveOverview::Line& line, const std::deque<TrendChange>& servingCells,
                  Trend::Time now);
    /// Another radio's figures follow.
    void forget();

    bool isKnown() const { return !_name.isEmpty(); }      ///< seen since the last `forget`
    const QString& name() const { return _name; }          ///< "RSRP"
    const QString& number() const { return _number; }      ///< "-95.25"; a dash while it is not told
    const QString& unit() const { return _unit; }          ///< "dBm"; empty for a plain number
    const QString& grade() const { return _grade; }        ///< "good"; empty without one
    bool isGraded() const { return _isGraded; }            ///< has had a grade since the last `forget`
    int step() const { return _step; }                     ///< of the grade, 0 without one
    const QString& age() const { return _age; }            ///< "3 s ago"; empty when nobody knows
    bool isOld() const { return _isOld; }                  ///< so old that it must not pass for current
    const QString& sentence() const { return _sentence; }  ///< all of this for a screen reader
    const QString& summary() const { return _summary; }    ///< of the line, likewise
    const Trend& line() const { return _line; }
    const std::vector<TrendChange>& servingCells() const { return _servingCells; }
    Trend::Time lineEnd() const { return _lineEnd; }

Q_SIGNALS:
    void changed();
    void lineChanged();

private:
    QString _name;
    QString _number;
    QString _unit;
    QString _grade;
    bool _isGraded = false;
    int _step = 0;
    QString _age;
    bool _isOld = false;
    QString _sentence;
    QString _summary;
    Trend _line;
    std::string _lineUnit;  // which the line refers to
    std::vector<TrendChange> _servingCells;
    Trend::Time _lineEnd{0};
};

}  // namespace kelvo
