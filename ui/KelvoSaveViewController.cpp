#include "ui/KelvoSaveViewController.h"

#include <QGuiApplication>
#include <QInputMethod>

#include "model/Snapshot.h"
#include "platform/Environment.h"
#include "ui/ScreenHost.h"

namespace kelvo {

KelvoSaveViewController::KelvoSaveViewController(const ArrayRef& saveHistory, Services services)
    : _timeStamp(clock().now()),
      _saveHistory(saveHistory ? saveHistory->copy() : nullptr),
      _services(std::move(services)) {}

void KelvoSaveViewController::setSaveDescription(const QString& text) {
    if (_saveDescription == text.toStdString()) return;
    _saveDescription = text.toStdString();
    Q_EMIT saveDescriptionChanged();
}

void KelvoSaveViewController::savePressed() {
    QGuiApplication::inputMethod()->commit();  // what is still being composed belongs to the description
    writeSnapshot();
    close();
}

void KelvoSaveViewController::writeSnapshot() {
    const std::string path = Snapshot::pathInDirectory(_services.snapshotDirectory, clock().now());
    const Result<Bytes> bytes = Snapshot{_timeStamp, _saveHistory, _saveDescription}.propertyList();
    if (bytes && !writeFileInPlace(path, *bytes, WriteOver::OwnFile)) return;
    logLine(Level::Error, "Unable to write snapshot to %s", path);
    _services.host.showAlert(QStringLiteral("File Error"), QStringLiteral("Unable to write file to disk"),
                             QStringLiteral("Close"));
}

void KelvoSaveViewController::cancelPressed() { close(); }

// Later, so that the button's own action has returned before its screen goes.
void KelvoSaveViewController::close() {
    _services.queue.post([&host = _services.host] { host.closeSaveView(); });
}

void KelvoSaveViewController::backgroundTouched() { Q_EMIT resignFirstResponder(); }

void KelvoSaveViewController::didSelectRow(int) { Q_EMIT resignFirstResponder(); }

bool KelvoSaveViewController::textFieldShouldReturn() {
    Q_EMIT resignFirstResponder();
    return true;
}

int KelvoSaveViewController::rowCount(const QModelIndex& parent) const {
    return parent.isValid() || !_saveHistory ? 0 : static_cast<int>(_saveHistory->size());
}

QVariant KelvoSaveViewController::data(const QModelIndex& index, int role) const {
    if (!checkIndex(index, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid)) return {};
    if (role != DescriptionRole) return {};
    const DictionaryRef& entry = (*_saveHistory)[static_cast<std::size_t>(index.row())].dictionary();
    const std::string* text = entry ? (*entry)["Description"].string() : nullptr;
    return text != nullptr ? QString::fromStdString(*text) : QString();
}

QHash<int, QByteArray> KelvoSaveViewController::roleNames() const { return {{DescriptionRole, "description"}}; }

}  // namespace kelvo
