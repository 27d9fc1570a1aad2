import QtQuick
import Kelvo.Ui

// The places of a cell's texts: in one line where there is room, else in two, figures below one another.
Item {
    id: columns

    required property OverviewController overview
    required property bool oneLine

    required property string identity
    required property string level
    required property string quality
    required property string difference
    required property string age
    required property string mark
    property color color: Theme.text
    property color quietColor: Theme.secondaryText
    property int pixelSize: 15

    readonly property real wideFigure: 96
    readonly property real lineHeight: oneLine ? height : (height - 10) / 2
    readonly property string second: mark === "" || age === "" ? mark + age : mark + ", " + age
    // Without levels the qualities take their place.
    readonly property string firstFigure: overview.cellsHaveLevel ? level : quality
    readonly property string secondFigure: overview.cellsHaveLevel ? quality : ""
    readonly property real differenceWidth: overview.cellsHaveDifference ? (oneLine ? wideFigure : 84) : 0

    component Part: Text {
        y: columns.oneLine ? 0 : 5
        height: columns.lineHeight
        verticalAlignment: Text.AlignVCenter
        textFormat: Text.PlainText
        elide: Text.ElideRight
        color: columns.color
        font.pixelSize: columns.pixelSize
    }

    component Figure: Part {
        width: columns.wideFigure
        horizontalAlignment: Text.AlignRight
    }

    Part {
        x: 14
        width: firstFigure.x - x - 8
        text: columns.identity
        fontSizeMode: Text.HorizontalFit
        minimumPixelSize: Math.min(font.pixelSize, 12)
    }
    Figure {
        id: firstFigure
        x: columns.oneLine ? secondFigure.x - (columns.overview.cellsHaveLevel && columns.overview.cellsHaveQuality ? width : 0) : toServing.x - width
        text: columns.firstFigure
    }
    Figure {
        id: secondFigure
        x: columns.oneLine ? toServing.x - width : firstFigure.x
        y: columns.oneLine ? 0 : 5 + columns.lineHeight
        text: columns.secondFigure
        color: columns.quietColor
        font.pixelSize: Math.min(columns.pixelSize, columns.oneLine ? 15 : 13)
    }
    Figure {
        id: toServing
        x: (columns.oneLine ? heard.x : columns.width - 14) - width
        width: columns.differenceWidth
        text: columns.difference
        font.pixelSize: Math.min(columns.pixelSize, columns.oneLine ? 15 : 14)
    }
    Part {
        id: heard
        x: columns.oneLine ? columns.width - 14 - width : 14
        y: columns.oneLine ? 0 : 5 + columns.lineHeight
        width: columns.oneLine ? 150 : firstFigure.x - x - 8
        horizontalAlignment: columns.oneLine ? Text.AlignRight : Text.AlignLeft
        text: columns.second
        color: columns.quietColor
        font.pixelSize: Math.min(columns.pixelSize, 13)
    }
}
