import QtQuick
import Kelvo.Ui

// One entry of the history. The check mark says that it is part of the snapshot.
Item {
    id: row

    required property int index
    required property string description
    required property KelvoSaveViewController saveView

    height: 44

    Accessible.role: Accessible.ListItem
    Accessible.name: description
    Accessible.checked: true

    Text {
        anchors { left: parent.left; leftMargin: 14; right: check.left; rightMargin: 8; verticalCenter: parent.verticalCenter }
        text: row.description
        textFormat: Text.PlainText
        elide: Text.ElideRight
        color: Theme.text
        font { family: "Helvetica"; pixelSize: 13 }
    }

    Glyph {
        id: check
        objectName: "check"
        anchors { right: parent.right; rightMargin: 14; verticalCenter: parent.verticalCenter }
        shape: Glyph.Check
        color: Theme.accent
    }

    Hairline {
        anchors { left: parent.left; leftMargin: 14; right: parent.right; top: parent.top }
        visible: row.index > 0
    }

    TapHandler {
        onTapped: row.saveView.didSelectRow(row.index)
    }
}
