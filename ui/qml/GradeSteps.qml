pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// A grade as steps on a stair, beside its word.
Row {
    id: steps

    required property int step

    spacing: 3

    Repeater {
        model: 4

        Rectangle {
            required property int index
            readonly property bool reached: index < steps.step

            y: 14 - height
            width: 5
            height: 5 + 3 * index
            radius: 1
            color: reached ? Theme.accent : "transparent"
            border { width: reached ? 0 : 1; color: Theme.oldText }
        }
    }
}
