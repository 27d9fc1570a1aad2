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

        // A title that needs the room first becomes smaller, and then leaves the way back its arrow alone.
        // A third of the bar, or all that a title in its middle leaves.
        readonly property real named: Math.min(implicitWidth, Math.max(bar.width / 3, (bar.width - title.implicitWidth) / 2 - x - 4))
        readonly property bool roomForName: x + named + 4 + title.implicitWidth * 14 / 17 <= bar.width - 16

        anchors { left: parent.left; leftMargin: 4; verticalCenter: parent.verticalCenter }
        width: roomForName ? named : 40
        visible: bar.backTitle !== ""
        text: bar.backTitle
        textHidden: !roomForName
        leads: true
        Accessible.name: qsTr("Back to %1").arg(bar.backTitle)
        onClicked: bar.back()
    }

    Text {
        id: title

        readonly property real side: backButton.visible ? backButton.x + backButton.width + 4 : 16
        readonly property bool centred: implicitWidth <= bar.width - 2 * side

        x: centred ? (bar.width - implicitWidth) / 2 : side
        width: centred ? implicitWidth : bar.width - side - 16
        horizontalAlignment: Text.AlignHCenter
        anchors.verticalCenter: parent.verticalCenter
        text: bar.title
        textFormat: Text.PlainText
        elide: Text.ElideRight
        fontSizeMode: Text.HorizontalFit
        minimumPixelSize: 14
        color: Theme.text
        font { pixelSize: 17; bold: true }
        Accessible.ignored: !enabled
        Accessible.role: Accessible.Heading
        Accessible.name: text
    }

    Hairline {
        anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
    }
}
