pragma ComponentBehavior: Bound
import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// One pane: its title, its rows and its toolbar.
FocusScope {
    id: page

    required property KelvoPaneController pane
    required property NavigationStack navigation
    required property OverviewController overview  // null where there is none
    required property bool wide  // the overview stands beside

    Component.onDestruction: navigation.didRemoveView(pane)

    /// Where a row is, in the page's coordinates; empty for one that is not seen.
    function frameOf(row: int): rect {
        const item = list.itemAtIndex(row);
        return item ? item.mapToItem(page, Qt.rect(0, 0, item.width, item.height)) : Qt.rect(list.x, list.y, list.width, 0);
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }

    ListView {
        id: list

        anchors {
            top: titleBar.bottom
            bottom: toolbar.visible ? toolbar.top : parent.bottom
            horizontalCenter: parent.horizontalCenter
        }
        width: Math.min(parent.width, 640)
        clip: true
        focus: true
        activeFocusOnTab: true
        currentIndex: -1  // nothing is marked until a key is pressed
        highlightMoveDuration: 0
        maximumFlickVelocity: 6000
        reuseItems: true
        model: page.pane
        delegate: PaneRow {
            pane: page.pane
            width: list.width
            onTouched: list.currentIndex = -1
        }

        Accessible.ignored: !enabled
        Accessible.role: Accessible.List
        Accessible.name: page.pane.title

        function open(event: KeyEvent) {
            if (event.modifiers & Qt.ControlModifier)
                page.pane.showDetails(currentIndex);
            else
                page.pane.didSelectRow(currentIndex);
        }

        Keys.onReturnPressed: event => open(event)
        Keys.onEnterPressed: event => open(event)
        Keys.onMenuPressed: page.pane.showDetails(currentIndex)
        Keys.onSpacePressed: page.pane.didSelectRow(currentIndex)
        Keys.onPressed: event => {
            const page = Math.max(1, Math.floor(height / 50) - 1);
            const jumps = {
                [Qt.Key_Home]: -count,
                [Qt.Key_End]: count,
                [Qt.Key_PageUp]: -page,
                [Qt.Key_PageDown]: page
            };
            if (event.key in jumps) {
                currentIndex = Math.max(0, Math.min(count - 1, currentIndex + jumps[event.key]));
                event.accepted = true;
                return;
            }
            const row = currentItem as PaneRow;
            const plain = row && !(event.modifiers & Qt.AltModifier);
            if (plain && event.key === Qt.Key_Right)
                event.accepted = row.scrollSideways(80);
            else if (plain && event.key === Qt.Key_Left)
                event.accepted = row.scrollSideways(-80);
        }

        T.ScrollIndicator.vertical: T.ScrollIndicator {
            id: indicator
            implicitWidth: 7
            Accessible.ignored: true
            contentItem: Rectangle {
                implicitWidth: 3
                radius: 1.5
                color: Theme.secondaryText
                opacity: indicator.active && indicator.size < 1 ? 0.6 : 0
                Behavior on opacity {
                    NumberAnimation { duration: 300 }
                }
            }
        }
    }

    Text {
        anchors.centerIn: list
        width: list.width - 64
        visible: text !== ""
        text: page.pane.emptyText
        textFormat: Text.PlainText
        horizontalAlignment: Text.AlignHCenter
        wrapMode: Text.Wrap
        color: Theme.secondaryText
        font.pixelSize: 15
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    TitleBar {
        id: titleBar
        anchors { left: parent.left; right: parent.right; top: parent.top }
        title: page.pane.title
        backTitle: page.pane.backTitle
        column: list
        offersOverview: page.overview !== null && !page.wide && page.pane.backTitle === ""
        onBack: page.navigation.popViewController()
        onOverview: page.overview.show()
    }

    StatusBar {
        id: toolbar
        anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
        visible: !page.navigation.toolbarHidden
        pane: page.pane
        column: list
    }

    Connections {
        target: page.pane
        function onResignFirstResponder() {
            list.focus = false;
        }
    }

    onActiveFocusChanged: if (activeFocus) list.focus = true
}
