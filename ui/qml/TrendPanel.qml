pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// A trend: what is seen of it in numbers, its chart with the gestures and keys that move it, and what to lay over it.
Column {
    id: panel

    required property DetailsController details

    signal comparing

    spacing: 6

    component Numbers: Row {
        id: numbers

        required property color color
        required property string text
        property bool dashed: false

        spacing: 8

        // As the line is drawn.
        Row {
            anchors.verticalCenter: parent.verticalCenter
            spacing: numbers.dashed ? 3 : 0
            Repeater {
                model: 3
                Rectangle {
                    width: numbers.dashed ? 6 : 7
                    height: 3
                    color: numbers.color
                }
            }
        }
        Text {
            text: numbers.text
            textFormat: Text.PlainText
            color: Theme.text
            font.pixelSize: 13
        }
    }

    Numbers {
        visible: chart.statistics !== ""
        color: Theme.accent
        text: chart.statistics
    }

    Numbers {
        visible: panel.details.comparedWith !== ""
        color: Theme.secondaryText
        text: chart.otherStatistics
        dashed: true
    }

    Text {
        objectName: "comparedWith"
        width: parent.width
        visible: text !== ""
        text: panel.details.comparedWith
        textFormat: Text.PlainText
        elide: Text.ElideMiddle
        color: Theme.secondaryText
        font.pixelSize: 13
    }

    TrendChart {
        id: chart
        objectName: "chart"

        width: parent.width
        height: 220
        details: panel.details
        lineColor: Theme.accent
        otherColor: Theme.secondaryText
        textColor: Theme.secondaryText
        gridColor: Theme.hairline
        backgroundColor: Theme.row
        activeFocusOnTab: true

        Accessible.role: Accessible.Chart
        Accessible.name: qsTr("Trend")
        Accessible.description: summary
        Accessible.focusable: true
        Accessible.onIncreaseAction: moveCursor(1)
        Accessible.onDecreaseAction: moveCursor(-1)

        Keys.onPressed: event => {
            event.accepted = true;
            if (event.key === Qt.Key_Left)
                moveCursor(-1);
            else if (event.key === Qt.Key_Right)
                moveCursor(1);
            else if (event.key === Qt.Key_PageUp)
                moveBy(width / 2);
            else if (event.key === Qt.Key_PageDown)
                moveBy(-width / 2);
            else if (event.key === Qt.Key_End)
                showLatest();
            else if (event.key === Qt.Key_Plus)
                zoomBy(0.5, width);
            else if (event.key === Qt.Key_Minus)
                zoomBy(2, width);
            else if (event.key === Qt.Key_Escape)
                event.accepted = clearCursor();
            else
                event.accepted = false;
        }

        DragHandler {
            id: drag
            property real moved: 0
            target: null
            yAxis.enabled: false
            onActiveChanged: moved = 0
            onActiveTranslationChanged: {
                chart.moveBy(activeTranslation.x - moved);
                moved = activeTranslation.x;
            }
        }

        PinchHandler {
            id: pinch
            property real zoomed: 1
            target: null
            onActiveChanged: zoomed = 1
            onActiveScaleChanged: {
                chart.zoomBy(zoomed / activeScale, centroid.position.x);
                zoomed = activeScale;
            }
        }

        WheelHandler {
            acceptedDevices: PointerDevice.Mouse | PointerDevice.TouchPad
            target: null
            onWheel: event => chart.zoomBy(Math.pow(2, -event.angleDelta.y / 240), event.x)
        }

        TapHandler {
            onTapped: point => chart.readAt(point.position.x)
        }

        Rectangle {
            anchors.fill: parent
            visible: chart.activeFocus
            color: "transparent"
            radius: 6
            border { width: 2; color: Theme.accent }
        }
    }

    Text {
        objectName: "reading"
        width: parent.width
        height: implicitHeight
        text: chart.cursorText !== "" ? chart.cursorText : qsTr("Tap to read, drag to move, pinch to zoom")
        color: chart.cursorText !== "" ? Theme.text : Theme.secondaryText
        wrapMode: Text.Wrap
        font.pixelSize: 13
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    Flow {
        width: parent.width

        BarButton {
            text: panel.details.comparedWith === "" ? qsTr("Compare with…") : qsTr("Stop comparing")
            onClicked: panel.details.comparedWith === "" ? panel.comparing() : panel.details.stopComparing()
        }
        BarButton {
            visible: !chart.live
            text: qsTr("To the latest")
            onClicked: chart.showLatest()
        }
    }
}
