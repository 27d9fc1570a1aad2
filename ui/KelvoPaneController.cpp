#include "ui/KelvoPaneController.h"

#include <algorithm>

#include "ui/NavigationStack.h"
#include "ui/ScreenHost.h"

namespace kelvo {

KelvoPaneController::KelvoPaneController(NodeRef node, std::string path, ScreenHost& host)
    : _nodes(std::move(node)), _keyPath(std::move(path)), _host(host), _rows(rowsOf(_nodes)) {
    setTitle();
    createToolbarItems();
}

std::vector<KelvoPaneController::Row> KelvoPaneController::rowsOf(const NodeRef& node) {
    const KelvoModelNode::Children* children = node ? node->childNodes() : nullptr;
    std::vector<Row> rows;
    if (children == nullptr) return rows;
    rows.reserve(children->size());
    for (const NodeRef& child : *children) {
        const std::string* value = child->value();
        rows.push_back({QString::fromStdString(child->displayName()),
                        value != nullptr ? QString::fromStdString(*value) : QString(), child->childNodes() != nullptr});
    }
    return rows;
}

void KelvoPaneController::reloadWithNode(NodeRef node) {
    _nodes = std::move(node);
    setTitle();
    reloadData(rowsOf(_nodes));
    createToolbarItems();
    Q_EMIT reloaded();
}

void KelvoPaneController::setTitle() {
    const QString title = _nodes ? QString::fromStdString(_nodes->displayName()) : QStringLiteral("Kelvo");
    if (_title == title) return;
    _title = title;
    Q_EMIT titleChanged();
}

void KelvoPaneController::reloadData(std::vector<Row> rows) {
    const auto same = [](const Row& a, const Row& b) { return a.isSameChild(b); };
    const auto head = std::mismatch(_rows.begin(), _rows.end(), rows.begin(), rows.end(), same);
    const auto tail = std::mismatch(_rows.rbegin(), std::make_reverse_iterator(head.first), rows.rbegin(),
                                    std::make_reverse_iterator(head.second), same);
    const auto first = static_cast<std::size_t>(head.first - _rows.begin());
    const auto last = static_cast<std::size_t>(tail.first.base() - _rows.begin());
    const auto count = static_cast<std::size_t>(tail.second.base() - head.second);
    replaceRows(first, last, rows, count);
    updateValues(0, first, rows.data());
    updateValues(first + count, _rows.size(), rows.data());
}

void KelvoPaneController::replaceRows(std::size_t first, std::size_t last, const std::vector<Row>& rows,
                                      std::size_t count) {
    const auto at = static_cast<std::ptrdiff_t>(first);
    if (first < last) {
        beginRemoveRows({}, static_cast<int>(first), static_cast<int>(last) - 1);
        _rows.erase(_rows.begin() + at, _rows.begin() + static_cast<std::ptrdiff_t>(last));
        endRemoveRows();
    }
    if (count > 0) {
        const auto source = rows.begin() + at;
        beginInsertRows({}, static_cast<int>(first), static_cast<int>(first + count) - 1);
        _rows.insert(_rows.begin() + at, source, source + static_cast<std::ptrdiff_t>(count));
        endInsertRows();
    }
    if (first < last || count > 0) selectRow(-1);
}

void KelvoPaneController::updateValues(std::size_t first, std::size_t last, const Row* rows) {
    for (std::size_t row = first; row < last; ++row) {
        if (_rows[row].value == rows[row].value) continue;
        _rows[row].value = rows[row].value;
        const QModelIndex changed = index(static_cast<int>(row));
        Q_EMIT dataChanged(changed, changed, {ValueRole});
    }
}

void KelvoPaneController::setStatus(const QString& status, bool isLoading) {
    _status = status.isNull() ? QStringLiteral("") : status;
    _isLoading = isLoading;
    createToolbarItems();
}

void KelvoPaneController::createToolbarItems() {
    using Kind = ToolbarItem::Kind;
    std::vector<ToolbarItem> items = {
        {Kind::ActivityIndicator, {}, _isLoading}, {Kind::StatusLabel, _status}, {Kind::FlexibleSpace}};
    if (_host.allowSaveButton()) items.push_back({Kind::SaveButton});
    if (items == _toolbarItems) return;
    _toolbarItems = std::move(items);
    Q_EMIT toolbarChanged();
}

bool KelvoPaneController::offersSave() const { return _toolbarItems.back().kind == ToolbarItem::Kind::SaveButton; }

void KelvoPaneController::saveButtonPressed() {
    if (offersSave()) _host.showSaveView();
}

void KelvoPaneController::viewWillAppear() {
    setTitle();
    if (_navigationController != nullptr) _navigationController->setToolbarHidden(false);
    createToolbarItems();
    selectRow(-1);
}

void KelvoPaneController::viewWillDisappear() { Q_EMIT resignFirstResponder(); }

void KelvoPaneController::selectRow(int row) {
    if (_selectedRow == row) return;
    _selectedRow = row;
    Q_EMIT selectedRowChanged();
}

void KelvoPaneController::didSelectRow(int row) {
    const bool shown = _navigationController == nullptr || &_navigationController->topViewController() == this;
    if (!shown || row < 0 || row >= rowCount()) return;  // a second tap may come while the pane slides away
    const NodeRef child = (*_nodes->childNodes())[static_cast<std::size_t>(row)];
    selectRow(row);
    if (child->childNodes() == nullptr) return selectRow(-1);
    auto pane = std::make_unique<KelvoPaneController>(child, pathByAppending(_keyPath, child->displayName()), _host);
    pane->setStatus(_status, _isLoading);
    if (_navigationController != nullptr) _navigationController->pushViewController(std::move(pane), true);
}

QString KelvoPaneController::emptyText() const {
    if (!_rows.empty()) return {};
    if (!_nodes) return QStringLiteral("Waiting for the modem");
    return _nodes->childNodes() != nullptr ? QStringLiteral("None reported") : QStringLiteral("Nothing reported yet");
}

int KelvoPaneController::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(_rows.size());
}

QVariant KelvoPaneController::data(const QModelIndex& index, int role) const {
    if (!checkIndex(index, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid)) return {};
    const Row& row = _rows[static_cast<std::size_t>(index.row())];
    switch (role) {
        case KeyRole: return row.key;
        case ValueRole: return row.value;
        case OpensRole: return row.opens;
        default: return {};
    }
}

QHash<int, QByteArray> KelvoPaneController::roleNames() const {
    return {{KeyRole, "key"}, {ValueRole, "value"}, {OpensRole, "opens"}};
}

}  // namespace kelvo
