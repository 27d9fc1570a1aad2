pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// What is known of a value, from top to bottom.
Column {
    id: content

    required property DetailsController details

    signal comparing

    padding: 16
    topPadding: 12
    spacing: 10

    component Line: Text {
        width: content.width - 2 * content.padding
        visible: text !== ""
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        color: Theme.secondaryText
        font.pixelSize: 14
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    Line {
        objectName: "place"
        text: content.details.place
        font.pixelSize: 13
    }

    FigureText {
        objectName: "largeValue"
        text: content.details.valueText
        maximumWidth: content.width - 2 * content.padding
        color: Theme.text
        font.pixelSize: 32
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    TrendPanel {
        visible: content.details.hasTrend
        width: content.width - 2 * content.padding
        details: content.details
        onComparing: content.comparing()
    }

    Repeater {
        model: content.details.changes

        Line {
            required property string modelData
            text: modelData
        }
    }
}
