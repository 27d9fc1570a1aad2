import QtQuick
import Kelvo.Ui

// Draws one row where KelvoCell puts it. The strip scrolls sideways when a value is too long for the row.
KelvoCell {
    id: row

    required property int index
    required property bool fresh
    required age
    required property KelvoPaneController pane
    readonly property bool marked: ListView.isCurrentItem && ListView.view.activeFocus
    readonly property real valueWidth: valueFrame.width
    property real lastValueWidth: 0
    // Values are measured bold and drawn regular: what is drawn may fit although what was measured does not.
    readonly property real drawnEnd: shownValue !== "" ? value.x + value.implicitWidth : name.x + name.width
    readonly property real areaWidth: width - 22 - (opens ? 18 : 0)

    signal touched

    height: 50
    contentArea: Qt.rect(0, 0, areaWidth, content.height)

    function scrollSideways(by: real): bool {
        if (!strip.interactive)
            return false;
        strip.contentX = Math.max(0, Math.min(strip.contentWidth - strip.width, strip.contentX + by));
        return true;
    }

    // A shorter value may end before the place that was swiped to; a finger on the row keeps the place.
    onValueWidthChanged: {
        if (valueWidth < lastValueWidth && !strip.dragging) {
            strip.cancelFlick();
            strip.contentX = 0;
        }
        lastValueWidth = valueWidth;
    }

    ListView.onPooled: {
        visible = false;
        strip.contentX = 0;
    }
    ListView.onReused: visible = true

    Accessible.ignored: !enabled  // a screen that covers the pane covers it for a screen reader, too
    Accessible.role: Accessible.ListItem
    Accessible.name: accessibleName
    Accessible.focusable: true
    Accessible.focused: marked
    Accessible.onPressAction: pane.didSelectRow(index)

    Rectangle {
        anchors.fill: parent
        color: tap.pressed && row.opens || row.pane.selectedRow === row.index ? Theme.pressed : Theme.row
    }

    Item {
        id: content

        x: 6
        width: row.areaWidth + (row.opens ? 0 : 10)  // what ends in the margin is seen
        height: row.height
        clip: strip.interactive

        Flickable {
            id: strip
            objectName: "strip"

            x: row.viewFrame.x
            y: row.viewFrame.y
            width: row.opens || row.viewFrame.width === 0 ? row.areaWidth : row.viewFrame.width
            height: content.height
            contentWidth: row.viewContentSize.width
            contentHeight: height
            flickableDirection: Flickable.HorizontalFlick
            interactive: !row.opens && contentWidth > width  // a row that showed a long value before may open now
            onInteractiveChanged: if (!interactive) contentX = 0

            Text {
                id: name
                x: row.keyFrame.x
                y: row.keyFrame.y
                // A name that no strip can scroll ends before the arrow.
                width: strip.interactive ? row.keyFrame.width : Math.min(row.keyFrame.width, strip.width - x)
                height: row.keyFrame.height
                text: row.key
                elide: Text.ElideRight
                textFormat: Text.PlainText
                color: Theme.text
                font { pixelSize: 15; bold: true }
                Accessible.ignored: true
            }

            FigureText {
                id: value
                x: row.valueFrame.x
                y: row.valueFrame.y
                text: row.shownValue
                color: row.age === "" ? Theme.secondaryText : Theme.oldText
                font.pixelSize: 15
            }

            Rectangle {
                id: mark
                objectName: "mark"
                x: value.x
                y: value.y + value.implicitHeight + 1
                width: value.implicitWidth
                height: 2
                color: Theme.accent
                opacity: 0
            }
        }

        // More of the value lies to the right.
        Rectangle {
            objectName: "fade"
            anchors { right: parent.right; top: parent.top; bottom: parent.bottom; bottomMargin: 1 }
            width: 28
            visible: strip.interactive && row.drawnEnd - strip.contentX > content.width
            gradient: Gradient {
                orientation: Gradient.Horizontal
                GradientStop { position: 0; color: Qt.rgba(Theme.row.r, Theme.row.g, Theme.row.b, 0) }
                GradientStop { position: 1; color: Theme.row }
            }
        }
    }

    Glyph {
        objectName: "disclosure"
        anchors { right: parent.right; rightMargin: 14; verticalCenter: parent.verticalCenter }
        visible: row.opens
        width: 14
        height: 14
        shape: Glyph.Disclosure
        color: Theme.secondaryText
    }

    Hairline {
        anchors { left: parent.left; leftMargin: 16; right: parent.right; bottom: parent.bottom }
    }

    Rectangle {
        anchors { fill: parent; margins: 2 }
        visible: row.marked
        color: "transparent"
        radius: 6
        border { width: 2; color: Theme.accent }
    }

    // A value that changed stands out at once and calms down slowly. The line under it is for bright light and for eyes that
    // tell colours apart badly: accent and text colour differ in their hue alone.
    states: State {
        name: "fresh"
        when: row.fresh
        PropertyChanges { value.color: Theme.accent; mark.opacity: 1 }
    }
    transitions: Transition {
        from: "fresh"
        ColorAnimation { duration: 400 }
        NumberAnimation { target: mark; property: "opacity"; duration: 400 }
    }

    TapHandler {
        id: tap
        objectName: "tap"
        onPressedChanged: if (pressed) row.touched()
        onTapped: row.pane.didSelectRow(row.index)
        onLongPressed: if (!row.opens) row.pane.showDetails(row.index)
    }

    TapHandler {
        acceptedDevices: PointerDevice.Mouse | PointerDevice.TouchPad | PointerDevice.Stylus
        acceptedButtons: Qt.RightButton
        onTapped: row.pane.showDetails(row.index)
    }
}
