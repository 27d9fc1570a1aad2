pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// The cells around the serving one. There is room for as many as there were at most, so that what follows stands still.
OverviewCard {
    id: card

    required property OverviewController overview
    readonly property bool oneLine: width >= 600
    readonly property int rowHeight: oneLine ? 36 : 50

    signal revealed(item: Item)

    objectName: "overviewCells"
    title: qsTr("Cells around")
    visible: overview.cells.most > 0

    CellHeader {
        width: card.width
        overview: card.overview
        oneLine: card.oneLine
    }

    KeyedRows {
        id: rows
        objectName: "cellRows"
        width: card.width
        count: card.overview.cells.count
        onReached: row => card.revealed(cells.itemAt(row))

        Accessible.ignored: !enabled
        Accessible.role: Accessible.List
        Accessible.name: card.title

        Repeater {
            id: cells
            model: card.overview.cells

            CellRow {
                width: card.width
                height: card.rowHeight
                overview: card.overview
                oneLine: card.oneLine
                marked: rows.activeFocus && rows.currentRow === index
            }
        }
    }

    Item {
        width: card.width
        height: (Math.max(3, card.overview.cells.most) - card.overview.cells.count) * card.rowHeight

        Text {
            x: 14
            height: card.rowHeight
            verticalAlignment: Text.AlignVCenter
            visible: card.overview.cells.count === 0
            text: qsTr("None heard")
            color: Theme.secondaryText
            font.pixelSize: 14
            Accessible.ignored: !enabled
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
    }
}
