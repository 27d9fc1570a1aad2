#include "ui/KelvoPaneController.h"

#include <algorithm>
#include <utility>

#include "model/TrendWords.h"
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
    Q_EMIT hintsChanged();
}

void KelvoPaneController::setTitle() {
    const QString title = _nodes ? QString::fromStdString(_nodes->displayName()) : QStringLiteral("Kelvo");
    if (_title == title) return;
    _title = title;
    Q_EMIT titleChanged();
}

// More are beyond what a modem reports and would hold the window up: such lists begin anew.
constexpr std::size_t kMostComparisons = 4'000'000;

// The view is told of differences only: rows that stay keep their place, their highlight and the finger on them.
// Children that swapped places are taken out and put in again.
void KelvoPaneController::reloadData(const std::vector<Row>& rows) {
    const auto same = [](const Row& row, const Row& other) { return row.isSameChild(other); };
    const bool differs = !std::ranges::equal(_rows, rows, same);
    if (differs && _rows.size() * rows.size() > kMostComparisons) return resetRows(rows);
    std::size_t at = 0;
    while (at < _rows.size() || at < rows.size()) {
        if (at < _rows.size() && at < rows.size() && _rows[at].isSameChild(rows[at])) {
            ++at;
        } else if (const std::size_t gone = leadingWithout(_rows, rows, at); gone > 0) {
            dropRows(at, gone);
        } else if (const std::size_t come = leadingWithout(rows, _rows, at); come > 0) {
            addRows(at, come, rows);
            at += come;
        } else {
            dropRows(at, 1);
        }
    }
    updateValues(rows);
}

void KelvoPaneController::resetRows(const std::vector<Row>& rows) {
    beginResetModel();
    _rows = rows;
    endResetModel();
    selectRow(-1);
}

std::size_t KelvoPaneController::leadingWithout(const std::vector<Row>& rows, const std::vector<Row>& others,
                                                std::size_t from) {
    const auto first = static_cast<std::ptrdiff_t>(from);
    const auto isAmongOthers = [&](const Row& row) {
        return from < others.size() && std::any_of(others.begin() + first, others.end(),
                                                   [&](const Row& other) { return other.isSameChild(row); });
    };
    if (from >= rows.size()) return 0;
    return static_cast<std::size_t>(std::find_if(rows.begin() + first, rows.end(), isAmongOthers) - rows.begin() -
                                    first);
}

void KelvoPaneController::dropRows(std::size_t first, std::size_t count) {
    if (count == 0) return;
    const int from = static_cast<int>(first);
    const int to = static_cast<int>(first + count);
    beginRemoveRows({}, from, to - 1);
    _rows.erase(_rows.begin() + from, _rows.begin() + to);
    endRemoveRows();
    if (_selectedRow >= from) selectRow(_selectedRow < to ? -1 : _selectedRow - (to - from));
}

void KelvoPaneController::addRows(std::size_t first, std::size_t count, const std::vector<Row>& rows) {
    if (count == 0) return;
    const int from = static_cast<int>(first);
    const int to = static_cast<int>(first + count);
    beginInsertRows({}, from, to - 1);
    _rows.insert(_rows.begin() + from, rows.begin() + from, rows.begin() + to);
    endInsertRows();
    if (_selectedRow >= from) selectRow(_selectedRow + (to - from));
}

void KelvoPaneController::updateValues(const std::vector<Row>& rows) {
    bool anyFresh = false;
    for (std::size_t at = 0; at < _rows.size(); ++at) {
        const bool changed = _rows[at].value != rows[at].value;
        _rows[at].value = rows[at].value;
        setFresh(at, changed, changed ? QList<int>{ValueRole} : QList<int>());
        anyFresh = anyFresh || changed;
    }
    ++_reloads;
    updateAges();
    if (!anyFresh) return;
    _host.queue().postAfter(kFreshTime, _lifetime.whileAlive([this, reload = _reloads] {
        if (_reloads == reload) letFreshRowsAge();
    }));
}

QString KelvoPaneController::ageOf(std::size_t row) const {
    const KelvoModelNode::Children* children = _nodes ? _nodes->childNodes() : nullptr;
    if (children == nullptr || row >= children->size() || _rows[row].opens) return {};
    const auto age = _host.ageOf(*(*children)[row]);
    constexpr std::chrono::seconds kSteps{10};  // in which it is told, so that nobody hears of every refresh
    return age && *age >= kOldFrom ? QString::fromStdString(ageText(*age - *age % kSteps)) : QString();
}

void KelvoPaneController::updateAges() {
    for (std::size_t at = 0; at < _rows.size(); ++at) {
        QString age = ageOf(at);
        if (_rows[at].age == age) continue;
        _rows[at].age = std::move(age);
        const QModelIndex row = index(static_cast<int>(at));
        Q_EMIT dataChanged(row, row, {AgeRole});
    }
}

void KelvoPaneController::letFreshRowsAge() {
    for (std::size_t at = 0; at < _rows.size(); ++at) setFresh(at, false, {});
}

void KelvoPaneController::setFresh(std::size_t row, bool fresh, QList<int> changed) {
    if (std::exchange(_rows[row].fresh, fresh) != fresh) changed.append(FreshRole);
    if (changed.isEmpty()) return;
    const QModelIndex at = index(static_cast<int>(row));
    Q_EMIT dataChanged(at, at, changed);
}

void KelvoPaneController::setStatus(const QString& status, bool isLoading) {
    _status = status.isNull() ? QStringLiteral("") : status;
    _isLoading = isLoading;
    createToolbarItems();
}

void KelvoPaneController::setConnection(const Connection& connection) {
    const bool calm = connection.isConnected() && !connection.isSilent();
    setHints(QString::fromStdString(waitingText(connection)),
             calm ? QString() : QString::fromStdString(connectionText(connection)));
}

void KelvoPaneController::setHints(const QString& waiting, const QString& note) {
    _waiting = waiting;
    _note = note;
    Q_EMIT hintsChanged();
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
    updateAges();
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
    pane->setHints(_waiting, _note);
    if (_navigationController != nullptr) _navigationController->pushViewController(std::move(pane), true);
}

void KelvoPaneController::showDetails(int row) {
    const bool shown = _navigationController == nullptr || &_navigationController->topViewController() == this;
    if (!shown || row < 0 || row >= rowCount()) return;
    const NodeRef child = (*_nodes->childNodes())[static_cast<std::size_t>(row)];
    const bool isOfList = child->displayName() == std::to_string(row);  // so entries are called
    if (child->childNodes() != nullptr && !isOfList) return;
    _host.showDetails(pathByAppending(_keyPath, child->displayName()), row);
}

QString KelvoPaneController::emptyText() const {
    if (!_rows.empty()) return {};
    if (!_nodes) return _waiting;
    return _nodes->childNodes() != nullptr ? QStringLiteral("None reported") : QStringLiteral("Nothing reported yet");
}

QString KelvoPaneController::note() const {
    const bool saidInPlaceOfRows = !_nodes && _note == _waiting;
    return saidInPlaceOfRows ? QString() : _note;
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
        case FreshRole: return row.fresh;
        case AgeRole: return row.age;
        default: return {};
    }
}

QHash<int, QByteArray> KelvoPaneController::roleNames() const {
    return {{KeyRole, "key"}, {ValueRole, "value"}, {OpensRole, "opens"}, {FreshRole, "fresh"}, {AgeRole, "age"}};
}

}  // namespace kelvo
