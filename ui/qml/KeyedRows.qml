import QtQuick

// Rows below one another that the arrow keys walk along. Where they end, the keys go on to what the rows stand in.
Column {
    id: rows

    required property int count
    property int currentRow: -1

    signal chosen(int row)
    signal reached(int row)

    function walk(by: int): bool {
        const next = Math.max(0, Math.min(count - 1, currentRow + by));
        if (next === currentRow)
            return false;
        currentRow = next;
        reached(next);
        return true;
    }

    activeFocusOnTab: count > 0
    onCountChanged: currentRow = Math.min(currentRow, count - 1)
    onActiveFocusChanged: {
        if (!activeFocus)
            return;
        currentRow = Math.max(0, currentRow);
        reached(currentRow);
    }

    Keys.onReturnPressed: chosen(currentRow)
    Keys.onEnterPressed: chosen(currentRow)
    Keys.onSpacePressed: chosen(currentRow)
    Keys.onUpPressed: event => event.accepted = walk(-1)
    Keys.onDownPressed: event => event.accepted = walk(1)
}
