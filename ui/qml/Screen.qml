pragma ComponentBehavior: Bound
import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// The window's content: the stack of panes, the save screen over it, and an alert over both.
FocusScope {
    id: screen

    required property KelvoApp application
    property SaveSheet sheet: null
    property DetailsSheet details: null

    focus: true
    onWidthChanged: {
        const page = stack.currentItem as PanePage;
        if (details && page)
            details.rowFrame = page.frameOf(details.details.row);
    }

    function giveFocus() {
        if (alert.shown)
            alert.forceActiveFocus();
        else if (sheet)
            sheet.forceActiveFocus();
        else if (details)
            details.forceActiveFocus();
        else
            stack.forceActiveFocus();
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }

    T.StackView {
        id: stack

        anchors.fill: parent
        focus: true
        enabled: !screen.sheet && !screen.details && !alert.shown

        pushEnter: Slide { property: "x"; from: stack.width; to: 0 }
        pushExit: Slide { property: "x"; from: 0; to: -stack.width / 3 }
        popEnter: Slide { property: "x"; from: -stack.width / 3; to: 0 }
        popExit: Slide { property: "x"; from: 0; to: stack.width }

        Keys.onPressed: event => {
            const back = event.key === Qt.Key_Escape || event.key === Qt.Key_Back || event.key === Qt.Key_Backspace
                || (event.key === Qt.Key_Left && (event.modifiers & Qt.AltModifier));
            event.accepted = back && screen.application.navigation.popViewController();
        }

        function show(pane: KelvoPaneController, animated: bool) {
            push(page, { "pane": pane }, animated ? T.StackView.PushTransition : T.StackView.Immediate);
        }

        Component.onCompleted: show(screen.application.navigation.rootViewController, false)
    }

    Shortcut {
        sequence: "Ctrl+Q"
        onActivated: screen.Window.window.close()
    }

    // The mouse's button for the way back.
    TapHandler {
        acceptedButtons: Qt.BackButton
        enabled: stack.enabled
        onTapped: screen.application.navigation.popViewController()
    }

    // A swipe from the left edge leads back, with a finger or with the mouse's button held down. What lies under the edge
    // takes every tap there, and every swipe up and down.
    Item {
        width: 24
        height: stack.height

        DragHandler {
            target: null
            enabled: stack.enabled && stack.depth > 1 && !stack.busy
            yAxis.enabled: false
            onActiveTranslationChanged: if (activeTranslation.x > 64) screen.application.navigation.popViewController()
        }
    }

    Component {
        id: page
        PanePage {
            navigation: screen.application.navigation
        }
    }

    Component {
        id: saveSheet
        SaveSheet {
            application: screen.application
            anchors.fill: parent
        }
    }

    Component {
        id: detailsSheet
        DetailsSheet {
            application: screen.application
            anchors.fill: parent
        }
    }

    AlertBox {
        id: alert
        anchors.fill: parent
        z: 1
        application: screen.application
        onShownChanged: screen.giveFocus()
    }

    Connections {
        target: screen.application.navigation

        function onPushed(pane: KelvoPaneController, animated: bool) {
            stack.show(pane, animated);
        }
        function onPopped(depth: int, animated: bool) {
            stack.pop(stack.get(depth - 1), animated ? T.StackView.PopTransition : T.StackView.Immediate);
        }
    }

    Connections {
        target: screen.application

        function onSaveViewPresented(presented: KelvoSaveViewController) {
            screen.sheet = saveSheet.createObject(screen, { "saveView": presented }) as SaveSheet;
            screen.giveFocus();
        }
        function onSaveViewDismissed() {
            screen.sheet.leave();
            screen.sheet = null;
            screen.giveFocus();
        }
        function onDetailsPresented(presented: DetailsController) {
            const page = stack.currentItem as PanePage;
            screen.details = detailsSheet.createObject(screen, { "details": presented, "rowFrame": page.frameOf(presented.row) }) as DetailsSheet;
            screen.giveFocus();
        }
        function onDetailsDismissed() {
            screen.details.leave();
            screen.details = null;
            screen.giveFocus();
        }
    }

    component Slide: Transition {
        property alias property: animation.property
        property alias from: animation.from
        property alias to: animation.to
        NumberAnimation {
            id: animation
            duration: 240
            easing.type: Easing.OutCubic
        }
    }
}
