pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// Values before and after an event.
Column {
    id: table

    required property var names
    required property var before
    required property var after

    bottomPadding: 10

    component Part: Text {
        required property bool heading

        y: 3
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        color: heading ? Theme.secondaryText : Theme.text
        font.pixelSize: heading ? 12 : 13
    }

    component Line: Item {
        id: line

        property string name
        property string before
        property string after
        property bool heading: false

        width: table.width
        height: Math.max(name.implicitHeight, before.implicitHeight, after.implicitHeight) + 6
        Accessible.ignored: heading || !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: qsTr("%1: before %2, after %3").arg(line.name).arg(line.before).arg(line.after)

        Part {
            id: name
            heading: line.heading
            x: 14
            width: before.x - x - 8
            text: line.name
            color: Theme.secondaryText
        }
        Part {
            id: before
            heading: line.heading
            x: 14 + (line.width - 28) * 0.28
            width: after.x - x - 8
            text: line.before
        }
        Part {
            id: after
            heading: line.heading
            x: 14 + (line.width - 28) * 0.64
            width: line.width - 14 - x
            text: line.after
        }
    }

    Line {
        heading: true
        before: qsTr("Before")
        after: qsTr("After")
    }

    Repeater {
        model: table.names

        Line {
            required property int index
            required property string modelData

            name: modelData
            before: table.before[index] || "–"
            after: table.after[index] || "–"
        }
    }
}
