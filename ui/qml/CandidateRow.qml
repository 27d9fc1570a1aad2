import QtQuick
import Kelvo.Ui

// A value that may be laid over another.
Item {
    id: row

    required property int index
    required property string modelData  // its key
    required property DetailsController details
    readonly property string place: details.candidatePlaces[index] ?? ""
    readonly property bool marked: ListView.isCurrentItem && ListView.view.activeFocus

    signal chosen

    height: 52

    Accessible.role: Accessible.ListItem
    Accessible.name: modelData + ", " + place
    Accessible.focusable: true
    Accessible.focused: marked
    Accessible.onPressAction: chosen()

    Rectangle {
        anchors.fill: parent
        color: tap.pressed ? Theme.pressed : "transparent"
    }

    Text {
        id: key
        anchors { left: parent.left; leftMargin: 14; right: parent.right; rightMargin: 14; top: parent.top; topMargin: 7 }
        text: row.modelData
        textFormat: Text.PlainText
        elide: Text.ElideRight
        color: Theme.text
        font { pixelSize: 15; bold: true }
    }
    Text {
        anchors { left: key.left; right: key.right; top: key.bottom }
        text: row.place
        textFormat: Text.PlainText
        elide: Text.ElideMiddle
        color: Theme.secondaryText
        font.pixelSize: 13
    }

    Hairline {
        anchors { left: parent.left; leftMargin: 14; right: parent.right; bottom: parent.bottom }
    }

    Rectangle {
        anchors { fill: parent; margins: 2 }
        visible: row.marked
        color: "transparent"
        radius: 6
        border { width: 2; color: Theme.accent }
    }

    TapHandler {
        id: tap
        onTapped: row.chosen()
    }
}
