pragma ComponentBehavior: Bound
import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// The save screen: what will be saved, a description, Save and Cancel.
FocusScope {
    id: sheet

    required property KelvoApp application
    required property KelvoSaveViewController saveView

    readonly property bool moving: arriving.running || leaving.running

    function leave() {
        enabled = false;
        leaving.start();
    }

    Component.onCompleted: arriving.start()
    Component.onDestruction: application.didRemoveSaveView(saveView)
    Keys.onEscapePressed: saveView.cancelPressed()
    Keys.onPressed: event => {
        if (event.key === Qt.Key_Back) {
            event.accepted = true;
            saveView.cancelPressed();
        }
    }
    Accessible.role: Accessible.Dialog
    Accessible.name: heading.text

    Connections {
        target: sheet.saveView
        function onResignFirstResponder() {
            sheet.forceActiveFocus();
            rest.forceActiveFocus();
        }
    }

    Item {
        id: rest  // has the keyboard while nobody needs it
        focus: true
    }

    Rectangle {
        id: shade
        anchors.fill: parent
        color: Theme.shade
    }

    Rectangle {
        id: panel

        anchors.horizontalCenter: parent.horizontalCenter
        y: 24
        width: Math.min(parent.width, 640)
        height: parent.height
        radius: 14
        color: Theme.background
        border { width: 1; color: Theme.hairline }

        MouseArea {
            anchors.fill: parent
            onPressed: sheet.saveView.backgroundTouched()
        }

        BarButton {
            id: cancel
            anchors { left: parent.left; leftMargin: 4; top: parent.top; topMargin: 6 }
            enabled: !sheet.saveView.saving
            text: qsTr("Cancel")
            onClicked: sheet.saveView.cancelPressed()
        }

        Text {
            id: heading
            anchors { horizontalCenter: parent.horizontalCenter; top: parent.top; topMargin: 18 }
            width: panel.width - 2 * Math.max(cancel.width, save.width) - 8
            horizontalAlignment: Text.AlignHCenter
            fontSizeMode: Text.HorizontalFit
            minimumPixelSize: 13
            elide: Text.ElideRight
            text: qsTr("Save Snapshot")
            color: Theme.text
            font { pixelSize: 17; bold: true }
        }

        ActivityIndicator {
            anchors { horizontalCenter: save.horizontalCenter; verticalCenter: save.verticalCenter }
            running: sheet.saveView.saving
            color: Theme.secondaryText
        }

        BarButton {
            id: save
            anchors { right: parent.right; rightMargin: 4; top: parent.top; topMargin: 6 }
            visible: !sheet.saveView.saving
            text: qsTr("Save")
            strong: true
            onClicked: sheet.saveView.savePressed()
        }

        Column {
            id: column

            anchors { top: parent.top; topMargin: 64; horizontalCenter: parent.horizontalCenter }
            width: parent.width - 32
            spacing: 8

            T.TextField {
                id: field
                width: parent.width
                implicitHeight: 48
                leftPadding: 14
                rightPadding: 14
                verticalAlignment: TextInput.AlignVCenter
                text: sheet.saveView.saveDescription
                color: Theme.text
                selectionColor: Theme.accent
                selectedTextColor: Theme.row
                placeholderText: qsTr("Description")
                font.pixelSize: 16
                activeFocusOnTab: true
                readOnly: sheet.saveView.saving
                Accessible.name: placeholderText
                onTextEdited: sheet.saveView.saveDescription = text
                onAccepted: sheet.saveView.textFieldShouldReturn()
                background: Rectangle {
                    radius: 10
                    color: Theme.row
                    border { width: field.activeFocus ? 2 : 1; color: field.activeFocus ? Theme.accent : Theme.hairline }
                    Text {
                        anchors { left: parent.left; leftMargin: 14; verticalCenter: parent.verticalCenter }
                        visible: field.text === "" && field.preeditText === ""
                        text: field.placeholderText
                        color: Theme.secondaryText
                        font: field.font
                    }
                }
            }

            Text {
                topPadding: 14
                leftPadding: 14
                text: history.count > 0 ? qsTr("In this snapshot") : qsTr("Nothing recorded yet")
                color: Theme.secondaryText
                font.pixelSize: 13
            }

            Rectangle {
                width: parent.width
                height: history.height + 2
                visible: history.count > 0
                radius: 10
                color: Theme.row
                border { width: 1; color: Theme.hairline }

                ListView {
                    id: history
                    anchors { left: parent.left; right: parent.right; top: parent.top; margins: 1 }
                    height: Math.min(contentHeight, Math.max(44, sheet.height - 240))
                    interactive: contentHeight > height
                    clip: interactive
                    model: sheet.saveView
                    delegate: HistoryRow {
                        width: history.width
                        saveView: sheet.saveView
                    }
                    Accessible.role: Accessible.List
                    Accessible.name: qsTr("In this snapshot")
                }
            }
        }
    }

    ParallelAnimation {
        id: arriving
        NumberAnimation { target: panel; property: "y"; from: sheet.height; to: 24; duration: 280; easing.type: Easing.OutCubic }
        NumberAnimation { target: shade; property: "opacity"; from: 0; to: 1; duration: 280 }
    }

    SequentialAnimation {
        id: leaving
        ParallelAnimation {
            NumberAnimation { target: panel; property: "y"; to: sheet.height; duration: 220; easing.type: Easing.InCubic }
            NumberAnimation { target: shade; property: "opacity"; to: 0; duration: 220 }
        }
        ScriptAction { script: sheet.destroy() }
    }
}
