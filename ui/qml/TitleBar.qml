import QtQuick
import Kelvo.Ui

// The pane's name, and the way back under the name of the pane below.
Rectangle {
    id: bar

    required property string title
    required property string backTitle
    required property Item column  // where the rows are
    property bool offersOverview: false

    signal back
    signal overview

    height: 52
    color: Theme.bar

    BarButton {
        id: backButton
        objectName: "back"

        readonly property real smallest: 44  // for a thumb

        // A title that needs the room first becomes smaller, and then leaves the way back its arrow alone.
        // A third of the column, or all that a title in its middle leaves.
        readonly property real named: Math.max(smallest, Math.min(implicitWidth, Math.max(bar.column.width / 3, (bar.column.width - title.implicitWidth) / 2 - 8)))
        readonly property bool roomForName: 4 + named + 4 + title.implicitWidth * 14 / 17 <= bar.column.width - 16

        x: bar.column.x + 4
        anchors.verticalCenter: parent.verticalCenter
        width: roomForName ? named : smallest
        visible: bar.backTitle !== ""
        text: bar.backTitle
        textHidden: !roomForName
        leads: true
        Accessible.name: qsTr("Back to %1").arg(bar.backTitle)
        onClicked: bar.back()
    }

    Text {
        id: title

        readonly property real side: backButton.visible ? 4 + backButton.width + 4 : 16
        readonly property bool centred: implicitWidth <= bar.column.width - 2 * side

        x: bar.column.x + (centred ? (bar.column.width - implicitWidth) / 2 : side)
        width: centred ? implicitWidth : bar.column.width - side - 16
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

    BarButton {
        objectName: "overview"
        x: bar.column.x + bar.column.width - 4 - width
        anchors.verticalCenter: parent.verticalCenter
        visible: bar.offersOverview
        text: qsTr("Overview")
        onClicked: bar.overview()
    }

    Hairline {
        anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
    }
}
