import QtQuick
import Kelvo.Ui

// The pane's toolbar: activity indicator, status, room, and Save where saving is allowed.
Rectangle {
    id: bar

    required property KelvoPaneController pane
    required property Item column  // where the rows are

    height: 50
    color: Theme.bar

    Hairline {
        anchors { left: parent.left; right: parent.right; top: parent.top }
    }

    ActivityIndicator {
        id: indicator
        x: bar.column.x + 16
        anchors.verticalCenter: parent.verticalCenter
        running: bar.pane.loading
        color: Theme.secondaryText
    }

    FigureText {
        id: status
        objectName: "status"
        anchors.verticalCenter: parent.verticalCenter
        x: bar.column.x + inset
        maximumWidth: bar.column.width - inset - (save.visible ? save.width + 4 : 16)
        text: bar.pane.status
        color: Theme.text
        font.pixelSize: 14
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text

        property real inset: indicator.running ? 44 : 16
        Behavior on inset {
            NumberAnimation { duration: 160; easing.type: Easing.OutCubic }
        }
    }

    // Below the status text, which keeps its place whether this is there or not.
    FigureText {
        objectName: "note"
        anchors { left: status.left; top: status.bottom; topMargin: -1 }
        maximumWidth: status.maximumWidth
        text: bar.pane.note
        visible: text !== ""
        color: Theme.secondaryText
        font.pixelSize: 12
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    BarButton {
        id: save
        x: bar.column.x + bar.column.width - 4 - width
        anchors.verticalCenter: parent.verticalCenter
        visible: bar.pane.offersSave
        text: qsTr("Save")
        onClicked: bar.pane.saveButtonPressed()
    }
}
