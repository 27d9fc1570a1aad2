import QtQuick
import Kelvo.Ui

// A cell around the serving one.
CellColumns {
    id: row

    required property int index
    required property string sentence
    required property bool marked
    readonly property bool lost: mark === "lost"

    color: lost ? Theme.oldText : Theme.text
    quietColor: lost ? Theme.oldText : Theme.secondaryText

    Accessible.ignored: !enabled
    Accessible.role: Accessible.ListItem
    Accessible.name: sentence
    Accessible.focusable: true
    Accessible.focused: marked

    Hairline {
        anchors { left: parent.left; leftMargin: 14; right: parent.right; top: parent.top }
        visible: row.index > 0
    }

    FocusFrame {
        visible: row.marked
    }
}
