pragma ComponentBehavior: Bound
import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// The window's content: the stack of panes, the save screen over it, and an alert over both.
FocusScope {
    id: screen

    required property KelvoApp application
    property var sheet: null  // a SaveSheet
    property var details: null  // a DetailsSheet

    readonly property OverviewController overview: application.overview  // null where nothing is live
    readonly property bool overviewOpen: overview !== null && overview.open
    readonly property bool wide: overview !== null && width >= 900  // for the panes and the overview side by side
    readonly property bool uncovered: !sheet && !details && !alert.shown
    property real arrival: overviewOpen ? 1 : 0  // of the overview over the panes

    focus: true
    onWideChanged: giveFocus()
    onWidthChanged: {
        const page = stack.currentItem as PanePage;
        if (details && page)
            details.rowFrame = page.frameOf(details.details.row);
    }

    // What the first frame does not show is named by its file alone, which is read when it is wanted first: a type's name
    // would have it read, with all that it is made of, before that frame.
    function made(file: string, owner: Item, properties: var): var {
        const all = Object.assign({ application: application, "anchors.fill": owner }, properties);
        return Qt.createComponent(file).createObject(owner, all);
    }

    function giveFocus() {
        if (alert.shown)
            alert.forceActiveFocus();
        else if (sheet)
            sheet.forceActiveFocus();
        else if (details)
            details.forceActiveFocus();
        else if (overviewOpen)
            beside.forceActiveFocus();
        else
            stack.forceActiveFocus();
    }

    // False where nothing lies behind.
    function back(): bool {
        if (wide || !overviewOpen)
            return application.navigation.popViewController();
        overview.close();
        return true;
    }

    Behavior on arrival {
        enabled: !screen.wide
        NumberAnimation { duration: 240; easing.type: Easing.OutCubic }
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }

    T.StackView {
        id: stack

        x: screen.wide ? 0 : -screen.arrival * width / 3
        width: screen.wide ? Math.max(400, Math.min(640, screen.width - 560)) : screen.width  // 640 is what rows use
        height: screen.height
        focus: true
        enabled: screen.uncovered && (screen.wide || !screen.overviewOpen)

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

    // Where the overview is: on a phone over the panes, in a wide window beside them.
    FocusScope {
        id: beside
        objectName: "beside"

        readonly property bool used: screen.wide || screen.overviewOpen || screen.arrival > 0
        property var view: null  // an OverviewView

        x: screen.wide ? stack.width : (1 - screen.arrival) * screen.width
        width: screen.wide ? screen.width - stack.width : screen.width
        height: screen.height
        enabled: screen.uncovered && (screen.wide || screen.overviewOpen)

        function leave() {
            screen.overview.close();
            stack.forceActiveFocus();
        }

        onUsedChanged: {
            if (used) {
                view = screen.made("OverviewView.qml", beside, { wide: Qt.binding(() => screen.wide), focus: true });
                view.back.connect(leave);
            } else {
                view.visible = false;  // it lives a moment longer
                view.destroy();
                view = null;
            }
        }
    }

    Shortcut {
        sequence: "Ctrl+O"
        enabled: screen.uncovered && screen.overview !== null
        onActivated: screen.overviewOpen ? screen.giveFocus() : screen.overview.show()
    }

    Shortcut {
        sequence: "Ctrl+Q"
        onActivated: screen.Window.window.close()
    }

    // The mouse's button for the way back.
    TapHandler {
        acceptedButtons: Qt.BackButton
        enabled: screen.uncovered
        onTapped: screen.back()
    }

    // A swipe from the left edge leads back, with a finger or with the mouse's button held down. What lies under the edge
    // takes every tap there, and every swipe up and down.
    Item {
        width: 24
        height: stack.height

        DragHandler {
            target: null
            enabled: screen.uncovered && !stack.busy && (stack.depth > 1 || (!screen.wide && screen.arrival === 1))
            yAxis.enabled: false
            onActiveTranslationChanged: if (activeTranslation.x > 64) screen.back()
        }
    }

    Component {
        id: page
        PanePage {
            navigation: screen.application.navigation
            overview: screen.overview
            wide: screen.wide
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
        target: screen.overview

        function onOpenChanged() {
            screen.giveFocus();
        }
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
            screen.sheet = screen.made("SaveSheet.qml", screen, { saveView: presented });
            screen.giveFocus();
        }
        function onSaveViewDismissed() {
            screen.sheet.leave();
            screen.sheet = null;
            screen.giveFocus();
        }
        function onDetailsPresented(presented: DetailsController) {
            const page = stack.currentItem as PanePage;
            screen.details = screen.made("DetailsSheet.qml", screen, { details: presented, rowFrame: page.frameOf(presented.row) });
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
