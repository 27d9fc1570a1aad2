pragma ComponentBehavior: Bound
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

    readonly property real wideFigure: oneLine ? 96 : 90
    readonly property real lineHeight: oneLine ? height : (height - 10) / 2
    readonly property string second: mark === "" || age === "" ? mark + age : mark + ", " + age
    // Without levels the qualities take their place.
    readonly property string firstFigure: overview.cellsHaveLevel ? level : knownQuality
    readonly property string secondFigure: overview.cellsHaveLevel ? knownQuality : ""
    readonly property string knownQuality: overview.cellsHaveQuality ? quality : ""
    readonly property real differenceWidth: overview.cellsHaveDifference ? (oneLine ? wideFigure : 80) : 0
    // From right to left.
    readonly property real end: width - 14
    readonly property real heardWidth: oneLine ? 150 : 0
    readonly property real differenceX: end - heardWidth - differenceWidth
    readonly property real lastFigureX: differenceX - wideFigure
    readonly property real firstFigureX: oneLine && overview.cellsHaveLevel && overview.cellsHaveQuality ? lastFigureX - wideFigure : lastFigureX
    readonly property real secondLine: oneLine ? 0 : 5 + lineHeight

    component Part: Text {
        y: columns.oneLine ? 0 : 5
        height: columns.lineHeight
        verticalAlignment: Text.AlignVCenter
        textFormat: Text.PlainText
        color: columns.color
        font.pixelSize: columns.pixelSize
    }

    component Figure: Part {
        width: columns.wideFigure
        horizontalAlignment: Text.AlignRight
    }

    Part {
        x: 14
        width: columns.firstFigureX - 22
        text: columns.identity
        elide: Text.ElideRight
        fontSizeMode: Text.HorizontalFit
        minimumPixelSize: Math.min(font.pixelSize, 12)
    }
    Figure {
        x: columns.firstFigureX
        text: columns.firstFigure
    }
    Figure {
        x: columns.lastFigureX
        y: columns.secondLine
        text: columns.secondFigure
        color: columns.quietColor
        font.pixelSize: Math.min(columns.pixelSize, columns.oneLine ? 15 : 13)
    }
    Figure {
        x: columns.differenceX
        width: columns.differenceWidth
        visible: columns.overview.cellsHaveDifference
        text: columns.difference
        font.pixelSize: Math.min(columns.pixelSize, columns.oneLine ? 15 : 14)
    }
    Part {
        x: columns.oneLine ? columns.end - columns.heardWidth : 14
        y: columns.secondLine
        width: columns.oneLine ? columns.heardWidth : columns.firstFigureX - 22
        horizontalAlignment: columns.oneLine ? Text.AlignRight : Text.AlignLeft
        text: columns.second
        elide: Text.ElideRight
        color: columns.quietColor
        font.pixelSize: Math.min(columns.pixelSize, 13)
    }
}
