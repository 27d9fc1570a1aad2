pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// One line of text whose digits do not move when they change.
Item {
    id: figures

    property alias text: layout.text
    property alias font: layout.font
    property alias maximumWidth: layout.maximumWidth
    property color color

    implicitWidth: layout.width
    implicitHeight: layout.height

    FigureLayout {
        id: layout
    }

    Repeater {
        model: layout.count

        Text {
            required property int index

            x: layout.positions[index] ?? 0
            text: layout.texts[index] ?? ""
            textFormat: Text.PlainText
            color: figures.color
            font: layout.font
            Accessible.ignored: true
        }
    }
}
