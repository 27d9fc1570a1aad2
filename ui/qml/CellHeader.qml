import QtQuick
import Kelvo.Ui

// What the columns of the cells are.
CellColumns {
    identity: qsTr("Cell")
    level: qsTr("Level")
    quality: qsTr("Quality")
    difference: qsTr("To serving")
    age: qsTr("Heard")
    mark: ""
    height: oneLine ? 30 : 44
    pixelSize: 12
    color: Theme.secondaryText

    Hairline {
        anchors { left: parent.left; leftMargin: 14; right: parent.right; bottom: parent.bottom }
    }
}
