import QtQuick
import QtQuick as Quick
import Kelvo.Ui

// A line between things, as thin as the screen can draw it.
Rectangle {
    implicitHeight: 1 / Quick.Screen.devicePixelRatio
    color: Theme.hairline
}
