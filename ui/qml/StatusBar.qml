import QtQuick
import Kelvo.Ui

// The pane's toolbar: activity indicator, status, room, and Save where saving is allowed.
Rectangle {
    id: bar

    required property KelvoPaneController pane

    height: 50
    color: Theme.bar

    Hairline {
        anchors { left: parent.left; right: parent.right; top: parent.top }
    }

    ActivityIndicator {
        id: indicator
        anchors { left: parent.left; leftMargin: 16; verticalCenter: parent.verticalCenter }
        running: bar.pane.loading
        color: Theme.secondaryText
    }

    FigureText {
        anchors.verticalCenter: parent.verticalCenter
        x: indicator.running ? 44 : 16
        maximumWidth: bar.width - x - (save.visible ? save.width + 4 : 16)
        text: bar.pane.status
        color: Theme.text
        font.pixelSize: 14
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text
        Behavior on x {
            NumberAnimation { duration: 160; easing.type: Easing.OutCubic }
        }
    }

    BarButton {
        id: save
        anchors { right: parent.right; rightMargin: 4; verticalCenter: parent.verticalCenter }
        visible: bar.pane.offersSave
        text: qsTr("Save")
        onClicked: bar.pane.saveButtonPressed()
    }
}
