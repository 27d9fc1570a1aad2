#pragma once

#include <QtQml/qqmlregistration.h>
#include <QAbstractListModel>
#include <QByteArray>
#include <QList>
#include <QStringList>
#include <vector>

namespace kelvo {

/// Rows of texts, each text under the name of its role. New rows are told as the difference, place by place, so that
/// the items that draw them stay. Main thread only.
class TextRows : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its rows")
    Q_PROPERTY(int count READ count NOTIFY countChanged)
    Q_PROPERTY(int most READ most NOTIFY countChanged)
public:
    explicit TextRows(QList<QByteArray> names) : _names(std::move(names)) {}

    /// Each row has a text for each name.
    void setRows(const std::vector<QStringList>& rows);
    /// Other rows than before follow: `most` begins anew.
    void clear();

    int count() const { return static_cast<int>(_rows.size()); }
    int most() const { return _most; }  ///< of all counts so far: the room that the rows have

    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : count(); }
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

Q_SIGNALS:
    void countChanged();

private:
    const QList<QByteArray> _names;
    std::vector<QStringList> _rows;
    int _most = 0;
};

}  // namespace kelvo
