import QtQuick
import Kelvo.Ui

// Where the phone is and how good it is there.
OverviewCard {
    id: card

    required property OverviewController overview
    readonly property bool twice: overview.quality.known
    readonly property bool stacked: width < 280
    readonly property bool graded: overview.level.graded || overview.quality.graded

    objectName: "overviewServing"

    Column {
        x: 14
        width: card.width - 28
        topPadding: 12
        bottomPadding: 8

        Item {
            width: parent.width
            height: 30
            Accessible.ignored: !enabled
            Accessible.role: Accessible.Heading
            Accessible.name: state.text === "" ? radio.text : radio.text + ", " + state.text

            Text {
                id: radio
                width: Math.min(implicitWidth, parent.width)
                text: card.overview.title
                textFormat: Text.PlainText
                elide: Text.ElideRight
                color: Theme.text
                font { pixelSize: 22; bold: true }
            }
            Text {
                id: state
                anchors { left: radio.right; leftMargin: 10; right: parent.right; bottom: radio.bottom; bottomMargin: 2 }
                text: card.overview.state
                textFormat: Text.PlainText
                elide: Text.ElideRight
                fontSizeMode: Text.HorizontalFit
                minimumPixelSize: 12
                color: Theme.secondaryText
                font.pixelSize: 17
            }
        }

        FigureText {
            height: 24
            visible: card.overview.cellKnown
            maximumWidth: parent.width
            text: card.overview.cell
            color: Theme.text
            font.pixelSize: 15
            Accessible.ignored: !enabled
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }

        Grid {
            topPadding: 10
            bottomPadding: 8
            columns: card.twice && !card.stacked ? 2 : 1
            columnSpacing: 20
            rowSpacing: 10

            OverviewGauge {
                objectName: "levelGauge"
                width: card.stacked || !card.twice ? card.width - 28 : Math.floor((card.width - 48) / 2)
                measure: card.overview.level
                visible: measure.known
                roomForGrade: card.graded
            }
            OverviewGauge {
                objectName: "qualityGauge"
                width: card.stacked ? card.width - 28 : Math.floor((card.width - 48) / 2)
                measure: card.overview.quality
                visible: measure.known
                roomForGrade: card.graded
            }
        }

        FactRows {
            width: parent.width
            rows: card.overview.serving
        }
    }
}
