import QtQuick
import Kelvo.Ui

// A section of the overview: its name, and what it has on a card.
Column {
    id: card

    property string title
    default property alias content: content.data

    spacing: 6

    Text {
        leftPadding: 14
        visible: card.title !== ""
        text: card.title
        color: Theme.secondaryText
        font.pixelSize: 13
        Accessible.ignored: !enabled
        Accessible.role: Accessible.Heading
        Accessible.name: text
    }

    Rectangle {
        width: card.width
        height: content.height
        radius: 10
        color: Theme.row
        border { width: 1; color: Theme.hairline }

        Column {
            id: content
            width: parent.width
        }
    }
}
