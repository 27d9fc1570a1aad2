import QtQuick
import Kelvo.Ui

// A level or a quality: its large figure, its grade in words, how old it is, and its last two minutes.
Column {
    id: gauge

    required property OverviewMeasure measure
    required property bool roomForGrade

    Accessible.ignored: !enabled
    Accessible.role: Accessible.StaticText
    Accessible.name: measure.sentence
    Accessible.description: measure.summary

    Item {
        width: parent.width
        height: 18

        Text {
            text: gauge.measure.name
            textFormat: Text.PlainText
            color: Theme.secondaryText
            font.pixelSize: 13
        }
        FigureText {
            objectName: "age"
            anchors.right: parent.right
            text: gauge.measure.age
            color: Theme.secondaryText
            font.pixelSize: 13
        }
    }

    Item {
        width: parent.width
        height: figure.implicitHeight

        FigureText {
            id: figure
            objectName: "figure"
            text: gauge.measure.number
            color: gauge.measure.old ? Theme.oldText : Theme.text
            font.pixelSize: Math.max(20, Math.min(38, Math.floor(gauge.width / 5)))
        }
        Text {
            anchors { left: figure.right; leftMargin: 5; bottom: figure.bottom; bottomMargin: figure.font.pixelSize / 6 }
            text: gauge.measure.unit
            textFormat: Text.PlainText
            color: Theme.secondaryText
            font.pixelSize: 15
        }
    }

    Item {
        width: parent.width
        height: 24
        visible: gauge.roomForGrade

        GradeSteps {
            id: steps
            anchors.verticalCenter: parent.verticalCenter
            visible: gauge.measure.step > 0
            step: gauge.measure.step
        }
        Text {
            objectName: "grade"
            anchors { left: steps.right; leftMargin: 8; verticalCenter: parent.verticalCenter }
            text: gauge.measure.grade
            color: Theme.text
            font.pixelSize: 15
        }
    }

    MeasureChart {
        width: parent.width
        height: 84
        measure: gauge.measure
        lineColor: Theme.accent
        textColor: Theme.secondaryText
        gridColor: Theme.hairline
        backgroundColor: Theme.row
    }
}
