pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// Something that happened, and when. Open it shows the values before and after.
Item {
    id: row

    required property int index
    required property string time
    required property string day
    required property string title
    required property string what
    required property string levels
    required property bool opens
    required property bool isOpen
    required property var names
    required property var before
    required property var after
    required property string sentence
    required property bool marked

    signal chosen
    signal grown

    height: 52 + values.height
    onHeightChanged: if (isOpen) grown()

    Rectangle {
        anchors { fill: parent; margins: 1 }
        radius: 9
        color: Theme.pressed
        visible: tap.pressed && row.opens
    }

    Item {
        id: head
        width: parent.width
        height: 52

        Accessible.ignored: !enabled
        Accessible.role: row.opens ? Accessible.Button : Accessible.ListItem
        Accessible.name: row.sentence
        Accessible.focusable: true
        Accessible.focused: row.marked
        Accessible.checkable: row.opens
        Accessible.checked: row.isOpen
        Accessible.onPressAction: row.chosen()

        Text {
            id: title
            anchors { left: parent.left; leftMargin: 14; top: parent.top; topMargin: 7 }
            width: Math.min(implicitWidth, time.x - x - 8)
            text: row.title
            elide: Text.ElideRight
            color: Theme.text
            font.pixelSize: 15
        }
        Text {
            anchors { left: title.right; leftMargin: 8; right: time.left; rightMargin: 8; baseline: title.baseline }
            text: row.levels
            textFormat: Text.PlainText
            elide: Text.ElideRight
            color: Theme.secondaryText
            font.pixelSize: 13
        }
        Text {
            id: time
            anchors { right: arrow.left; rightMargin: 8; baseline: title.baseline }
            text: row.time
            color: Theme.secondaryText
            font.pixelSize: 13
        }
        Text {
            anchors { left: title.left; right: day.left; rightMargin: 8; top: title.bottom; topMargin: 2 }
            text: row.what
            textFormat: Text.PlainText
            elide: Text.ElideRight
            color: Theme.secondaryText
            font.pixelSize: 13
        }
        Text {
            id: day
            anchors { right: time.right; top: title.bottom; topMargin: 2 }
            text: row.day
            color: Theme.secondaryText
            font.pixelSize: 13
        }
        Glyph {
            id: arrow
            anchors { right: parent.right; rightMargin: 12; verticalCenter: parent.verticalCenter }
            width: 12
            height: 12
            opacity: row.opens ? 1 : 0
            rotation: row.isOpen ? 90 : 0
            shape: Glyph.Disclosure
            color: Theme.secondaryText
        }

        TapHandler {
            id: tap
            onTapped: row.chosen()
        }
    }

    Column {
        id: values
        anchors { left: parent.left; right: parent.right; top: head.bottom }

        Repeater {
            model: row.isOpen ? 1 : 0

            EventValues {
                width: row.width
                names: row.names
                before: row.before
                after: row.after
            }
        }
    }

    Hairline {
        anchors { left: parent.left; leftMargin: 14; right: parent.right; top: parent.top }
        visible: row.index > 0
    }

    FocusFrame {
        visible: row.marked
    }
}
