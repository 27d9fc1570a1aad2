#include "ui/TextRows.h"

#include <algorithm>

namespace kelvo {

void TextRows::setRows(const std::vector<QStringList>& rows) {
    const std::size_t kept = std::min(_rows.size(), rows.size());
    const bool isOtherCount = _rows.size() != rows.size();
    for (std::size_t i = 0; i < kept; ++i) {
        if (_rows[i] == rows[i]) continue;
        QList<int> changed;
        for (int at = 0; at < _names.size(); ++at) {
            if (_rows[i][at] != rows[i][at]) changed.append(Qt::UserRole + 1 + at);
        }
        _rows[i] = rows[i];
        Q_EMIT dataChanged(index(static_cast<int>(i)), index(static_cast<int>(i)), changed);
    }
    const auto firstOther = static_cast<std::ptrdiff_t>(kept);
    if (_rows.size() > kept) {
        beginRemoveRows({}, static_cast<int>(kept), count() - 1);
        _rows.erase(_rows.begin() + firstOther, _rows.end());
        endRemoveRows();
    } else if (rows.size() > kept) {
        beginInsertRows({}, static_cast<int>(kept), static_cast<int>(rows.size()) - 1);
        _rows.insert(_rows.end(), rows.begin() + firstOther, rows.end());
        endInsertRows();
    }
    _most = std::max(_most, count());
    if (isOtherCount) Q_EMIT countChanged();
}

void TextRows::clear() {
    setRows({});
    _most = 0;
    Q_EMIT countChanged();
}

QVariant TextRows::data(const QModelIndex& index, int role) const {
    const int at = role - Qt::UserRole - 1;
    if (!index.isValid() || index.row() >= count() || at < 0 || at >= _names.size()) return {};
    return _rows[static_cast<std::size_t>(index.row())][at];
}

QHash<int, QByteArray> TextRows::roleNames() const {
    QHash<int, QByteArray> names;
    for (int at = 0; at < _names.size(); ++at) names.insert(Qt::UserRole + 1 + at, _names[at]);
    return names;
}

}  // namespace kelvo
