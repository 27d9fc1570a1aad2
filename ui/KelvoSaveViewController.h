#pragma once

#include <QtQml/qqmlregistration.h>
#include <QAbstractListModel>
#include <QString>
#include <memory>
#include <optional>
#include <string>

#include "platform/system/Clock.h"
#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/Worker.h"
#include "platform/values/Value.h"

namespace kelvo {

class ScreenHost;

/// The modal screen that saves a snapshot: the entries of the history (the rows), a description, Save and Cancel.
/// What it shows and saves is what it was handed; readings that arrive while it is up are not included.
/// Main thread only.
class KelvoSaveViewController : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its save screen")
    Q_PROPERTY(QString saveDescription READ saveDescription WRITE setSaveDescription NOTIFY saveDescriptionChanged)
    Q_PROPERTY(bool saving READ isSaving NOTIFY savingChanged)
public:
    enum Role { DescriptionRole = Qt::UserRole + 1 };  // in QML: description

    /// The references outlive the screen.
    struct Services {
        MainQueue& queue;
        ScreenHost& host;
        Worker& worker;                 ///< writes the file
        std::string snapshotDirectory;  ///< not created when it is missing
    };

    /// `saveHistory` (copied) is what the generator hands out; it may be none. Takes the time.
    KelvoSaveViewController(const ArrayRef& saveHistory, Services services);

    /// The text field's text; none when there is no field to ask.
    QString saveDescription() const { return QString::fromStdString(_saveDescription.value_or("")); }
    void setSaveDescription(const QString& text);
    void clearSaveDescription() { _saveDescription.reset(); }

    /// Writes the snapshot file beside the main queue, then closes; a failure is logged and alerted. Until it is
    /// written the screen stays and takes neither Save nor Cancel.
    Q_INVOKABLE void savePressed();
    Q_INVOKABLE void cancelPressed();  ///< closes without writing
    bool isSaving() const { return _saving; }
    Q_INVOKABLE void backgroundTouched();
    Q_INVOKABLE void didSelectRow(int row);
    Q_INVOKABLE bool textFieldShouldReturn();  ///< always true

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

Q_SIGNALS:
    void saveDescriptionChanged();
    void savingChanged();
    void resignFirstResponder();  ///< the text field gives the keyboard up

private:
    void writeSnapshot();
    static void close(const Services& services);

    const Clock::TimePoint _timeStamp;
    const ArrayRef _saveHistory;
    std::optional<std::string> _saveDescription = "";
    const Services _services;
    bool _saving = false;
    const Lifetime _lifetime;  // the work may outlive the screen
};

}  // namespace kelvo
