pragma ComponentBehavior: Bound
import QtQuick
import QtQuick.Templates as T
import Kelvo.Ui

// The overview: a screen of its own on a phone, and what stands beside the panes in a wide window.
FocusScope {
    id: view

    required property KelvoApp application
    required property bool wide
    readonly property OverviewController overview: application.overview
    readonly property KelvoPaneController pane: application.navigation.topViewController
    readonly property bool empty: pane.emptyText !== ""

    signal back

    Component.onCompleted: overview.watched = true
    Component.onDestruction: overview.watched = false

    Accessible.ignored: !enabled
    Accessible.role: Accessible.Pane
    Accessible.name: titleBar.title

    Keys.onPressed: event => {
        const leads = event.key === Qt.Key_Escape || event.key === Qt.Key_Back || event.key === Qt.Key_Backspace
            || (event.key === Qt.Key_Left && (event.modifiers & Qt.AltModifier));
        const page = scroll.height - 50;
        const steps = {
            [Qt.Key_Up]: -60,
            [Qt.Key_Down]: 60,
            [Qt.Key_PageUp]: -page,
            [Qt.Key_PageDown]: page,
            [Qt.Key_Home]: -scroll.contentHeight,
            [Qt.Key_End]: scroll.contentHeight
        };
        if (event.key in steps)
            scroll.scrollBy(steps[event.key]);
        else if (leads && !overview.events.closeAll())
            back();
        event.accepted = leads || event.key in steps;
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }

    TitleBar {
        id: titleBar
        anchors { left: parent.left; right: parent.right; top: parent.top }
        title: qsTr("Overview")
        backTitle: view.wide ? "" : view.pane.title
        column: sections
        onBack: view.back()
    }

    Flickable {
        id: scroll
        objectName: "overviewScroll"

        anchors { left: parent.left; right: parent.right; top: titleBar.bottom; bottom: toolbar.visible ? toolbar.top : parent.bottom }
        clip: true
        focus: true
        visible: !view.empty
        contentWidth: width
        contentHeight: sections.height
        flickableDirection: Flickable.VerticalFlick
        maximumFlickVelocity: 6000

        function scrollBy(pixels: real) {
            contentY = Math.max(0, Math.min(contentHeight - height, contentY + pixels));
        }
        function reveal(item: Item) {
            const top = item.mapToItem(sections, 0, 0).y;
            contentY = Math.max(0, Math.min(top - 8, Math.max(contentY, top + item.height + 8 - height)));
        }

        Column {
            id: sections

            x: (scroll.width - width) / 2
            width: Math.min(scroll.width, 760)
            padding: 12
            spacing: 12

            OverviewServing {
                width: sections.width - 24
                overview: view.overview
            }
            OverviewCells {
                width: sections.width - 24
                overview: view.overview
                onRevealed: item => scroll.reveal(item)
            }
            OverviewRegistration {
                width: sections.width - 24
                overview: view.overview
            }
            OverviewEvents {
                id: events
                width: sections.width - 24
                overview: view.overview
                onRevealed: item => scroll.reveal(item)
                // Who reads further down is not pushed away by what comes above.
                onGrewAbove: (top, height) => {
                    if (top < scroll.contentY - sections.y - events.y)
                        scroll.contentY += height;
                }
            }
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
        anchors.centerIn: scroll
        width: Math.min(view.width, 640) - 64
        visible: view.empty
        text: view.pane.emptyText
        horizontalAlignment: Text.AlignHCenter
        wrapMode: Text.Wrap
        color: Theme.secondaryText
        font.pixelSize: 15
        Accessible.ignored: !enabled
        Accessible.role: Accessible.StaticText
        Accessible.name: text
    }

    StatusBar {
        id: toolbar
        anchors { left: parent.left; right: parent.right; bottom: parent.bottom }
        visible: !view.wide && !view.application.navigation.toolbarHidden
        pane: view.pane
        column: sections
    }

    Hairline {
        anchors { left: parent.left; top: parent.top; bottom: parent.bottom }
        width: implicitHeight
        visible: view.wide
    }
}
