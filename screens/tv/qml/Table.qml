import QtQuick

// The list: its lines stand where the tree says, and slide there when that changes.
Item {
    id: table

    required property var stage
    readonly property real u: stage.unit

    function moves() {
        if (opacity !== stage.table.opacity || content.y !== -u * stage.table.offset)
            return true
        if (above.isMoving || below.isMoving)
            return true
        for (let i = 0; i < lines.count; ++i) {
            const line = lines.itemAt(i)
            if (line && line.isMoving)
                return true
        }
        return false
    }

    x: u * stage.table.frame.x
    y: u * stage.table.frame.y
    width: u * stage.table.frame.width
    height: u * stage.table.frame.height
    visible: stage.table.isShown
    clip: true
    opacity: stage.table.opacity
    Behavior on opacity {
        enabled: table.stage.hasMotion && table.visible
        NumberAnimation { duration: 250 }
    }

    Accessible.role: Accessible.List
    Accessible.name: stage.title.text

    Item {
        id: content

        width: parent.width
        y: -table.u * table.stage.table.offset
        Behavior on y {
            enabled: table.stage.hasMotion && table.visible
            NumberAnimation { duration: 160; easing.type: Easing.OutCubic }
        }

        Repeater {
            id: lines
            model: table.stage.lines
            delegate: TableLine {
                width: table.width
                stage: table.stage
            }
        }
    }

    // Rows beyond the edges fade out there.
    Veil {
        id: above
        stage: table.stage
        isShown: table.stage.table.hasMoreAbove
    }
    Veil {
        id: below
        stage: table.stage
        isShown: table.stage.table.hasMoreBelow
        anchors.bottom: parent.bottom
        rotation: 180
    }
}
