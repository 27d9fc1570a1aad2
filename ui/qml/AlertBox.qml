import QtQuick
import Kelvo.Ui

// An alert with one button, over everything until the button is pressed.
FocusScope {
    id: alert

    required property KelvoApp application
    readonly property bool shown: application.alertShown

    visible: shown
    Keys.onEscapePressed: application.alertButtonPressed()
    Keys.onBackPressed: application.alertButtonPressed()
    Accessible.role: Accessible.AlertMessage
    Accessible.name: title.text + ". " + message.text

    Rectangle {
        anchors.fill: parent
        color: Theme.shade
    }

    MouseArea {
        anchors.fill: parent  // nothing below is reached
        hoverEnabled: true
        onWheel: wheel => wheel.accepted = true
    }

    Rectangle {
        anchors.centerIn: parent
        width: Math.min(300, parent.width - 48)
        height: column.implicitHeight
        radius: 14
        color: Theme.raised

        Column {
            id: column
            width: parent.width
            topPadding: 22
            bottomPadding: 6

            Text {
                id: title
                width: parent.width
                horizontalAlignment: Text.AlignHCenter
                text: alert.application.alertTitle
                color: Theme.text
                font { pixelSize: 17; bold: true }
            }
            Text {
                id: message
                width: parent.width
                leftPadding: 20
                rightPadding: 20
                topPadding: 8
                bottomPadding: 20
                horizontalAlignment: Text.AlignHCenter
                wrapMode: Text.Wrap
                text: alert.application.alertMessage
                color: Theme.secondaryText
                font.pixelSize: 14
            }
            Hairline {
                width: parent.width
            }
            Item {
                width: parent.width
                height: 50
                BarButton {
                    anchors.centerIn: parent
                    focus: true
                    strong: true
                    text: alert.application.alertButton
                    onClicked: alert.application.alertButtonPressed()
                }
            }
        }
    }
}
