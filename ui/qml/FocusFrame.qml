import QtQuick
import Kelvo.Ui

// Where the keyboard is.
Rectangle {
    anchors { fill: parent; margins: 2 }
    color: "transparent"
    radius: 6
    border { width: 2; color: Theme.accent }
}
