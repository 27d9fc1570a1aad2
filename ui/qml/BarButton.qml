import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// A button that is only its text, and for the way back an arrow before it.
T.AbstractButton {
    id: button

    property bool leads: false
    property bool strong: false
    property bool textHidden: false

    implicitWidth: contentItem.implicitWidth + leftPadding + rightPadding
    implicitHeight: 44
    leftPadding: leads ? 6 : 12
    rightPadding: 12
    activeFocusOnTab: true
    focusPolicy: Qt.TabFocus
    Keys.onReturnPressed: clicked()
    Keys.onEnterPressed: clicked()

    Accessible.ignored: !enabled
    Accessible.role: Accessible.Button
    Accessible.name: text
    Accessible.onPressAction: clicked()

    contentItem: Label {
        text: button.text
        textHidden: button.textHidden
        leads: button.leads
        strong: button.strong
    }

    background: Rectangle {
        radius: 8
        color: button.down ? Theme.pressed : "transparent"
        border { width: button.visualFocus ? 2 : 0; color: Theme.accent }
    }

    component Label: Item {
        id: content

        property alias text: label.text
        property alias strong: label.font.bold
        property bool textHidden
        property bool leads

        implicitWidth: label.x + label.implicitWidth

        Glyph {
            visible: content.leads
            anchors.verticalCenter: parent.verticalCenter
            width: 20
            height: 20
            shape: Glyph.Back
            color: Theme.accent
        }
        Text {
            id: label
            visible: !content.textHidden
            x: content.leads ? 20 : 0
            width: parent.width - x
            anchors.verticalCenter: parent.verticalCenter
            textFormat: Text.PlainText
            elide: Text.ElideRight
            color: content.enabled ? Theme.accent : Theme.secondaryText
            font.pixelSize: 16
        }
    }
}
