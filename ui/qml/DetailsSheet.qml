pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// The details of a value: a sheet over a phone's screen, a box beside the row in a wide window.
FocusScope {
    id: sheet

    required property KelvoApp application
    required property DetailsController details
    required property rect rowFrame  // of the row that was asked, in the sheet's coordinates

    readonly property bool wide: width >= 720 && height >= 480
    readonly property bool moving: arriving.running || leaving.running
    property bool choosing: false  // of a value to compare with

    function leave() {
        enabled = false;
        leaving.start();
    }
    function back() {
        if (choosing)
            choosing = false;
        else
            details.close();
    }
    function choose(candidate: int) {
        details.compareWith(candidate);
        choosing = false;
    }

    onChoosingChanged: {
        if (choosing) {
            details.findCandidates();
            candidates.currentIndex = 0;
            candidates.forceActiveFocus();
        } else {
            done.forceActiveFocus();
        }
    }

    Component.onCompleted: arriving.start()
    Component.onDestruction: application.didRemoveDetails(details)
    Keys.onPressed: event => {
        const leads = event.key === Qt.Key_Escape || event.key === Qt.Key_Back || event.key === Qt.Key_Backspace
            || (event.key === Qt.Key_Left && (event.modifiers & Qt.AltModifier));
        event.accepted = leads;
        if (leads)
            back();
    }
    Accessible.role: Accessible.Dialog
    Accessible.name: details.title

    Rectangle {
        id: shade
        anchors.fill: parent
        color: sheet.wide ? "transparent" : Theme.shade
        opacity: 0
    }

    // Beside the panel is the way back, too.
    MouseArea {
        anchors.fill: parent
        acceptedButtons: Qt.LeftButton | Qt.RightButton | Qt.BackButton
        onClicked: sheet.details.close()
        onWheel: wheel => wheel.accepted = true
    }

    Rectangle {
        id: panel
        objectName: "detailsPanel"

        readonly property real below: sheet.rowFrame.y + sheet.rowFrame.height - 4
        readonly property real above: sheet.rowFrame.y + 4 - height
        readonly property real place: !sheet.wide ? sheet.height - height : below + height <= sheet.height - 12 ? below : above >= 12 ? above : (sheet.height - height) / 2
        property real slide: 1

        x: sheet.wide ? Math.max(12, Math.min(sheet.rowFrame.x + sheet.rowFrame.width, sheet.width - 12) - width) : (sheet.width - width) / 2
        y: place + (sheet.wide ? 0 : slide * height)
        opacity: sheet.wide ? 1 - slide : 1
        width: sheet.wide ? 440 : Math.min(sheet.width, 640)
        height: Math.min(bar.height + content.implicitHeight + 4, sheet.height - 24)
        radius: 14
        color: Theme.row
        border { width: 1; color: Theme.hairline }

        MouseArea {
            anchors.fill: parent  // a tap here closes nothing
            acceptedButtons: Qt.AllButtons
        }

        Item {
            id: bar
            width: parent.width
            height: 56

            BarButton {
                id: copy
                anchors { left: parent.left; leftMargin: 4; verticalCenter: parent.verticalCenter }
                text: sheet.choosing ? qsTr("Back") : qsTr("Copy")
                onClicked: sheet.choosing ? sheet.back() : sheet.details.copyValue()
            }
            Text {
                anchors { left: copy.right; right: done.left; verticalCenter: parent.verticalCenter }
                horizontalAlignment: Text.AlignHCenter
                text: sheet.choosing ? qsTr("Compare with…") : sheet.details.title
                textFormat: Text.PlainText
                fontSizeMode: Text.HorizontalFit
                minimumPixelSize: 13
                elide: Text.ElideRight
                color: Theme.text
                font { pixelSize: 17; bold: true }
                Accessible.role: Accessible.Heading
                Accessible.name: text
            }
            BarButton {
                id: done
                anchors { right: parent.right; rightMargin: 4; verticalCenter: parent.verticalCenter }
                focus: true
                strong: true
                text: qsTr("Done")
                onClicked: sheet.details.close()
            }
            Hairline {
                anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
            }
        }

        Flickable {
            id: scroll
            objectName: "detailsScroll"
            anchors { left: parent.left; right: parent.right; top: bar.bottom; bottom: parent.bottom; margins: 1 }
            visible: !sheet.choosing
            clip: true
            contentWidth: width
            contentHeight: content.implicitHeight
            interactive: contentHeight > height
            flickableDirection: Flickable.VerticalFlick

            DetailsContent {
                id: content
                width: scroll.width
                details: sheet.details
                onComparing: sheet.choosing = true
            }
        }

        ListView {
            id: candidates
            objectName: "candidates"
            anchors.fill: scroll
            visible: sheet.choosing
            clip: true
            activeFocusOnTab: true
            highlightMoveDuration: 0
            model: sheet.details.candidateTitles
            delegate: CandidateRow {
                width: candidates.width
                details: sheet.details
                onChosen: sheet.choose(index)
            }
            Keys.onReturnPressed: sheet.choose(currentIndex)
            Keys.onEnterPressed: sheet.choose(currentIndex)
            Keys.onSpacePressed: sheet.choose(currentIndex)
            Accessible.role: Accessible.List
            Accessible.name: qsTr("Compare with…")
        }
    }

    ParallelAnimation {
        id: arriving
        NumberAnimation { target: panel; property: "slide"; from: 1; to: 0; duration: sheet.wide ? 120 : 260; easing.type: Easing.OutCubic }
        NumberAnimation { target: shade; property: "opacity"; from: 0; to: 1; duration: 260 }
    }

    SequentialAnimation {
        id: leaving
        ParallelAnimation {
            NumberAnimation { target: panel; property: "slide"; to: 1; duration: sheet.wide ? 100 : 220; easing.type: Easing.InCubic }
            NumberAnimation { target: shade; property: "opacity"; to: 0; duration: 220 }
        }
        ScriptAction { script: sheet.destroy() }
    }
}
