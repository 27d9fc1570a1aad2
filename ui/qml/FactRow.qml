import QtQuick
import Kelvo.Ui

// A name and what stands for it. A text that was long once keeps its room.
Item {
    id: row

    required property string name
    required property string text  // of what the name says
    required property string sentence
    property real room: 0

    function keepRoom() {
        room = Math.max(room, value.implicitHeight);
    }

    height: Math.max(30, room + 10)
    onWidthChanged: {
        room = 0;
        keepRoom();
    }

    Accessible.ignored: !enabled
    Accessible.role: Accessible.StaticText
    Accessible.name: sentence

    Text {
        id: label
        anchors { left: parent.left; top: parent.top; topMargin: 6 }
        width: Math.min(implicitWidth, row.width / 2)
        text: row.name
        textFormat: Text.PlainText
        elide: Text.ElideRight
        color: Theme.secondaryText
        font.pixelSize: 14
    }
    Text {
        id: value
        anchors { left: label.right; leftMargin: 12; right: parent.right; top: label.top }
        horizontalAlignment: Text.AlignRight
        text: row.text
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        color: Theme.text
        font.pixelSize: metrics.advanceWidth > width && metrics.advanceWidth * 12 / 14 <= width ? 12 : 14
        onImplicitHeightChanged: row.keepRoom()
    }

    // A little too long for its line it becomes smaller rather than two lines.
    TextMetrics {
        id: metrics
        text: row.text
        font.pixelSize: 14
    }

    Hairline {
        anchors { left: parent.left; right: parent.right; top: parent.top }
    }
}
