#include "ui/KelvoSaveViewController.h"

#include <QGuiApplication>
#include <QInputMethod>

#include "model/Snapshot.h"
#include "platform/system/Environment.h"
#include "platform/system/WriteFileInPlace.h"
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
    if (_saving) return;
    QGuiApplication::inputMethod()->commit();  // what is still being composed belongs to the description
    _saving = true;
    Q_EMIT savingChanged();
    writeSnapshot();
}

void KelvoSaveViewController::writeSnapshot() {
    const std::string path = Snapshot::pathInDirectory(_services.snapshotDirectory, clock().now());
    const auto written = std::make_shared<bool>(false);
    const auto write = [written, path, snapshot = Snapshot{_timeStamp, _saveHistory, _saveDescription}] {
        const Result<Bytes> bytes = snapshot.propertyList();
        *written = bytes && writeFileInPlace(path, *bytes);
    };
    const auto leave = _lifetime.whileAlive([written, services = _services] {
        if (!*written) {
            services.host.showAlert(QStringLiteral("File Error"), QStringLiteral("Unable to write file to disk"),
                                    QStringLiteral("Close"));
        }
        close(services);
    });
    const auto finish = [written, path, leave] {
        if (!*written) logLine(Level::Error, "Unable to write snapshot to %s", path);
        leave();  // unless the program has ended meanwhile
    };
    _services.worker.run(write, finish);
}

void KelvoSaveViewController::cancelPressed() {
    if (!_saving) close(_services);
}

// Later, so that the button's own action has returned before its screen goes.
void KelvoSaveViewController::close(const Services& services) {
    services.queue.post([&host = services.host] { host.closeSaveView(); });
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
    const std::string* text = entry ? (*entry)[snapshot::kDescription].string() : nullptr;
    return text != nullptr ? QString::fromStdString(*text) : QString();
}

QHash<int, QByteArray> KelvoSaveViewController::roleNames() const { return {{DescriptionRole, "description"}}; }

}  // namespace kelvo
