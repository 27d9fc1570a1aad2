import QtQuick
import Kelvo.Ui

// The pane's name, and the way back under the name of the pane below.
Rectangle {
    id: bar

    required property string title
    required property string backTitle

    signal back

    height: 52
    color: Theme.bar

    BarButton {
        id: backButton
        anchors { left: parent.left; leftMargin: 4; verticalCenter: parent.verticalCenter }
        width: Math.min(implicitWidth, bar.width / 3)
        visible: bar.backTitle !== ""
        text: bar.backTitle
        leads: true
        Accessible.name: qsTr("Back to %1").arg(bar.backTitle)
        onClicked: bar.back()
    }

    Text {
        readonly property real side: backButton.visible ? backButton.x + backButton.width + 8 : 16
        readonly property bool centred: implicitWidth <= bar.width - 2 * side

        x: centred ? (bar.width - implicitWidth) / 2 : side
        width: centred ? implicitWidth : bar.width - side - 16
        anchors.verticalCenter: parent.verticalCenter
        text: bar.title
        textFormat: Text.PlainText
        elide: Text.ElideRight
        color: Theme.text
        font { pixelSize: 17; bold: true }
        Accessible.role: Accessible.Heading
        Accessible.name: text
    }

    Rectangle {
        anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
        height: 1
        color: Theme.hairline
    }
}
