#pragma once

#include <QtQml/qqmlregistration.h>
#include <QAbstractListModel>
#include <QList>
#include <QString>
#include <chrono>
#include <vector>

#include "model/Connection.h"
#include "model/KelvoModelNode.h"
#include "platform/system/Lifetime.h"

namespace kelvo {

class NavigationStack;
class ScreenHost;

/// One item of a pane's toolbar.
struct ToolbarItem {
    enum class Kind { ActivityIndicator, StatusLabel, FlexibleSpace, SaveButton };
    Kind kind;
    QString text = {};      ///< the label's
    bool spinning = false;  ///< the indicator's; hidden when stopped
    friend bool operator==(const ToolbarItem&, const ToolbarItem&) = default;
};

/// One table screen: the children of one node of the display tree, found again by its path after every rebuild.
/// Main thread only. Rows are ready to draw.
class KelvoPaneController : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its panes")
    Q_PROPERTY(QString title READ title NOTIFY titleChanged)
    Q_PROPERTY(QString backTitle READ backTitle CONSTANT)
    Q_PROPERTY(QString emptyText READ emptyText NOTIFY hintsChanged)
    Q_PROPERTY(QString note READ note NOTIFY hintsChanged)
    Q_PROPERTY(int selectedRow READ selectedRow NOTIFY selectedRowChanged)
    Q_PROPERTY(QString status READ status NOTIFY toolbarChanged)
    Q_PROPERTY(bool loading READ isLoading NOTIFY toolbarChanged)
    Q_PROPERTY(bool offersSave READ offersSave NOTIFY toolbarChanged)
public:
    /// In QML: key, value, opens, fresh, age.
    enum Role { KeyRole = Qt::UserRole + 1, ValueRole, OpensRole, FreshRole, AgeRole };

    /// A value that no record has written for so long is told to be old.
    static constexpr std::chrono::seconds kOldFrom{30};

    /// How long a row whose value changed in a reload stays fresh, so that the eye finds it.
    static constexpr std::chrono::milliseconds kFreshTime{900};

    /// A pane for `node`, which may be none, at `path`, which never changes. `host` outlives the pane.
    KelvoPaneController(NodeRef node, std::string path, ScreenHost& host);

    const std::string& path() const { return _keyPath; }
    const QString& title() const { return _title; }          ///< the node's name, "Kelvo" while there is none
    const QString& backTitle() const { return _backTitle; }  ///< the pane below; empty at the bottom of the stack
    QString emptyText() const;  ///< what to say in place of rows; empty while there are some
    /// A quiet line beside the status: that no records come, or why there is no connection where there are values
    /// still.
    QString note() const;
    int selectedRow() const { return _selectedRow; }  ///< the highlighted row, -1 for none

    /// Replaces the node. Only the rows that differ change, so that fingers and scroll positions stay where they are.
    void reloadWithNode(NodeRef node);
    void setStatus(const QString& status, bool isLoading);
    /// What `emptyText` and `note` tell of.
    void setConnection(const Connection& connection);
    /// The same in words: `waiting` stands in place of rows while there is no node, `note` beside the status.
    void setHints(const QString& waiting, const QString& note);
    /// Values may have become old since they were shown.
    void updateAges();
    void viewWillAppear();
    void viewWillDisappear();

    /// Left to right.
    const std::vector<ToolbarItem>& toolbarItems() const { return _toolbarItems; }
    const QString& status() const { return _status; }
    bool isLoading() const { return _isLoading; }
    bool offersSave() const;

    /// Pushes the pane of a child that has children; a leaf only loses its highlight.
    Q_INVOKABLE void didSelectRow(int row);
    /// Presents the details of a value, and those of an entry of a list. Other children that have children have none.
    Q_INVOKABLE void showDetails(int row);
    Q_INVOKABLE void saveButtonPressed();

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

Q_SIGNALS:
    void titleChanged();
    void hintsChanged();
    void selectedRowChanged();
    void toolbarChanged();
    void resignFirstResponder();  ///< the keyboard is no longer the pane's

private:
    friend class NavigationStack;  // which tells a pane where it stands

    struct Row {
        QString key;
        QString value;
        bool opens;
        bool fresh = false;
        QString age = {};  ///< "40 seconds old"; empty for a value that is not old
        bool isSameChild(const Row& other) const { return key == other.key && opens == other.opens; }
    };
    static std::vector<Row> rowsOf(const NodeRef& node);

    void setTitle();
    void createToolbarItems();
    void reloadData(const std::vector<Row>& rows);
    void resetRows(const std::vector<Row>& rows);
    /// How many of `rows` in a row, from index `from` on, are not among `others` from there on.
    static std::size_t leadingWithout(const std::vector<Row>& rows, const std::vector<Row>& others, std::size_t from);
    void dropRows(std::size_t first, std::size_t count);
    void addRows(std::size_t first, std::size_t count, const std::vector<Row>& rows);
    void updateValues(const std::vector<Row>& rows);
    /// Tells that a row has changed in the roles `changed`, and in its freshness when that does.
    void setFresh(std::size_t row, bool fresh, QList<int> changed);
    void letFreshRowsAge();
    /// The age to tell of a row; empty when there is none.
    QString ageOf(std::size_t row) const;
    void selectRow(int row);

    NodeRef _nodes;
    const std::string _keyPath;
    QString _status = QStringLiteral("");
    bool _isLoading = true;
    QString _waiting = QString::fromStdString(waitingText({}));
    QString _note = QString::fromStdString(connectionText({}));
    ScreenHost& _host;
    NavigationStack* _navigationController = nullptr;
    QString _title;
    QString _backTitle;
    int _selectedRow = -1;
    std::vector<Row> _rows;
    int _reloads = 0;
    std::vector<ToolbarItem> _toolbarItems;
    const Lifetime _lifetime;  // tasks on the queue outlive the pane
};

}  // namespace kelvo
