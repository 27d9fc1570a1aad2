import QtQuick
import Kelvo.Ui

// A line between things, as thin as the screen can draw it.
Rectangle {
    implicitHeight: 1 / Screen.devicePixelRatio
    color: Theme.hairline
}
