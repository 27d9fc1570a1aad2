#pragma once

#include <QtQml/qqmlregistration.h>
#include <QObject>
#include <QString>
#include <QStringList>
#include <string>
#include <vector>

#include "model/ShownValues.h"
#include "model/Trend.h"

namespace kelvo {

class ScreenHost;

/// The details of one value: the value itself and how it has gone, with another value over it when asked for. What it
/// shows follows the value's subject: a neighbor's details stay with the cell when its row changes.
/// Main thread only.
class DetailsController : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes the details of a value")
    Q_PROPERTY(QString title READ title CONSTANT)
    Q_PROPERTY(QString place READ place CONSTANT)
    Q_PROPERTY(int row READ row CONSTANT)
    Q_PROPERTY(QString valueText READ valueText NOTIFY changed)
    Q_PROPERTY(bool valueIsLong READ valueIsLong NOTIFY changed)
    Q_PROPERTY(QString meaning READ meaning CONSTANT)
    Q_PROPERTY(QString standard READ standard CONSTANT)
    Q_PROPERTY(QString written READ written NOTIFY changed)
    Q_PROPERTY(QString record READ record NOTIFY changed)
    Q_PROPERTY(QString modemTime READ modemTime NOTIFY changed)
    Q_PROPERTY(QString dump READ dump NOTIFY changed)
    Q_PROPERTY(QString dumpWords READ dumpWords NOTIFY changed)
    Q_PROPERTY(bool hasTrend READ hasTrend NOTIFY changed)
    Q_PROPERTY(QStringList changes READ changes NOTIFY changed)
    Q_PROPERTY(QString comparedWith READ comparedWith NOTIFY comparisonChanged)
    Q_PROPERTY(QStringList candidateTitles READ candidateTitles NOTIFY candidatesChanged)
    Q_PROPERTY(QStringList candidatePlaces READ candidatePlaces NOTIFY candidatesChanged)
public:
    /// Of the value at `path`, or of the main level of the list's row there. `row` is where it was asked for. The
    /// values and the host outlive it.
    DetailsController(const ShownValues& values, const std::string& path, int row, ScreenHost& host);

    const QString& title() const { return _title; }  ///< the value's key
    const QString& place() const { return _place; }  ///< the screens that lead to it, and what its row is about
    int row() const { return _row; }
    const QString& valueText() const { return _valueText; }
    bool valueIsLong() const { return _valueText.size() > 16; }  ///< for the largest type on a phone
    // What it means, in a sentence, and the standard that says so; empty for what nobody has explained.
    const QString& meaning() const { return _meaning; }
    const QString& standard() const { return _standard; }
    // Where the value comes from; each is empty when that is not known.
    const QString& written() const { return _written; }      ///< "4 seconds ago, by record 4711"; of a saved one, when
    const QString& record() const { return _record; }        ///< the record's kind: "0xb17f  LTE serving cell, idle"
    const QString& modemTime() const { return _modemTime; }  ///< by the modem's clock
    const QString& dump() const { return _dump; }            ///< as of `recordDump`
    const QString& dumpWords() const { return _dumpWords; }  ///< where the value stands in it
    bool hasTrend() const { return !_trend.points.empty(); }
    /// Of a text: what stood there and since when, the latest first.
    const QStringList& changes() const { return _changes; }

    const std::string& name() const { return _name; }  ///< of its trend
    const Trend& trend() const { return _trend; }
    /// Empty without one.
    const Trend& comparison() const { return _comparison; }
    const QString& comparedWith() const { return _comparedWith; }  ///< the other value's key and place; empty without
    const std::vector<TrendChange>& servingCells() const { return _servingCells; }
    Trend::Time now() const { return _now; }

    /// The values that can be laid over this one: the serving cell's and the best neighbor's first.
    const QStringList& candidateTitles() const { return _candidateTitles; }
    const QStringList& candidatePlaces() const { return _candidatePlaces; }
    Q_INVOKABLE void findCandidates();
    Q_INVOKABLE void compareWith(int candidate);
    Q_INVOKABLE void stopComparing();

    Q_INVOKABLE void copyValue();
    Q_INVOKABLE void close();

    /// Takes up what the values are now.
    void reload();

Q_SIGNALS:
    void changed();
    void comparisonChanged();
    void candidatesChanged();

private:
    /// The path of the leaf that stands for the node at `path`: itself, or the main level of a list's row.
    std::string leafOf(const KelvoModelNode& node, const std::string& path) const;
    void readMeaning(const std::string& path);
    void readChanges();
    QString sinceText(Trend::Time at) const;
    void readProvenance(const KelvoModelNode& node);

    const ShownValues& _values;
    ScreenHost& _host;
    const int _row;
    std::string _name;
    QString _title;
    QString _place;
    QString _valueText;
    QString _meaning;
    QString _standard;
    QString _written;
    QString _record;
    QString _modemTime;
    std::uint64_t _recordNumber = 0;  // of the dump
    QString _dump;
    QString _dumpWords;
    Trend _trend;
    std::string _comparisonName;
    Trend _comparison;
    QString _comparedWith;
    std::vector<TrendChange> _servingCells;
    QStringList _changes;
    Trend::Time _now{0};
    std::vector<std::string> _candidates;
    QStringList _candidateTitles;
    QStringList _candidatePlaces;
};

}  // namespace kelvo
