pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// What happened, newest first. A tap shows the values before and after.
OverviewCard {
    id: card

    required property OverviewController overview

    signal revealed(item: Item)
    signal grewAbove(top: real, height: real)

    objectName: "overviewEvents"
    title: qsTr("What happened")

    KeyedRows {
        id: rows
        objectName: "eventRows"
        width: card.width
        count: card.overview.events.count
        onReached: row => card.revealed(events.itemAt(row))
        onChosen: row => card.overview.events.toggle(row)

        Accessible.ignored: !enabled
        Accessible.role: Accessible.List
        Accessible.name: card.title

        Repeater {
            id: events
            model: card.overview.events

            EventRow {
                id: event
                width: card.width
                marked: rows.activeFocus && rows.currentRow === index
                onChosen: card.overview.events.toggle(index)
                onGrown: card.revealed(event)
            }
        }
    }

    Text {
        x: 14
        height: 44
        verticalAlignment: Text.AlignVCenter
        visible: card.overview.events.count === 0
        text: qsTr("Nothing yet")
        color: Theme.secondaryText
        font.pixelSize: 14
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    BarButton {
        objectName: "moreEvents"
        visible: card.overview.events.hasMore
        text: qsTr("Show earlier")
        onClicked: card.overview.showMoreEvents()
    }

    // The keyboard stays with its event.
    function growAbove(added: int) {
        if (rows.currentRow >= 0)
            rows.currentRow = Math.min(rows.currentRow + added, rows.count - 1);
        card.grewAbove(rows.y, added * 52);
    }

    Connections {
        target: card.overview.events
        function onRowsInserted(parent: var, first: int, last: int) {
            if (first === 0)
                card.growAbove(last - first + 1);
        }
        function onRowsMoved(parent: var, first: int, last: int) {
            card.growAbove(last - first + 1);
        }
    }
}
