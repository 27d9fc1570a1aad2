pragma ComponentBehavior: Bound
import QtQuick
import Kelvo.Ui

// Names and what stands for them, in as many columns as there is room for.
Grid {
    id: grid

    required property TextRows rows

    columns: width >= 560 ? 2 : 1
    columnSpacing: 32

    Repeater {
        model: grid.rows

        FactRow {
            width: (grid.width - (grid.columns - 1) * grid.columnSpacing) / grid.columns
        }
    }
}
