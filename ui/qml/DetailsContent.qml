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

    Line {
        objectName: "largeValue"
        text: content.details.valueText
        wrapMode: Text.WrapAtWordBoundaryOrAnywhere
        color: Theme.text
        font.pixelSize: content.details.valueIsLong ? 20 : 32
    }

    Column {
        width: content.width - 2 * content.padding
        spacing: 2

        Line {
            objectName: "meaning"
            text: content.details.meaning
            color: Theme.text
        }
        Line {
            objectName: "standard"
            text: content.details.standard
            font.pixelSize: 13
        }
    }

    Column {
        width: content.width - 2 * content.padding
        spacing: 2

        Line {
            objectName: "written"
            text: content.details.written
        }
        Line {
            objectName: "record"
            text: content.details.record
        }
        Line {
            objectName: "modemTime"
            text: content.details.modemTime
        }
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

    Line {
        objectName: "dumpWords"
        text: content.details.dumpWords
    }

    Text {
        objectName: "dump"
        width: content.width - 2 * content.padding
        visible: text !== ""
        text: content.details.dump
        textFormat: Text.StyledText
        color: Theme.secondaryText
        font { family: "monospace"; pixelSize: 13 }
        Accessible.ignored: true  // the words above say what matters
    }
}
