import QtQuick

// An alert over everything: its texts, its field with the keyboard, its actions.
Rectangle {
    id: alert

    required property var stage
    readonly property real u: stage.unit
    readonly property var look: stage.alert
    readonly property real wantedOpacity: look.isShown ? 1 : 0
    readonly property real capWidth: (panel.width - 120 * u) / 22
    readonly property real capHeight: 74 * u

    function moves() {
        if (opacity !== wantedOpacity)
            return true
        for (const items of [actions, caps])
            for (let i = 0; i < items.count; ++i)
                if (items.itemAt(i) && items.itemAt(i).isMoving)
                    return true
        return false
    }

    color: "#99101722"
    opacity: wantedOpacity
    visible: opacity > 0
    Behavior on opacity {
        enabled: alert.stage.hasMotion
        NumberAnimation { duration: 180 }
    }

    Rectangle {
        id: panel

        anchors.centerIn: parent
        width: alert.u * (alert.look.hasField ? 1280 : 1000)
        height: content.height + 112 * alert.u
        radius: 24 * alert.u
        color: "#ffffff"

        Accessible.role: Accessible.AlertMessage
        Accessible.name: alert.look.title !== "" ? alert.look.title : alert.look.message
        Accessible.description: alert.look.title !== "" ? alert.look.message : ""
        Accessible.ignored: !alert.look.isShown

        Column {
            id: content

            x: 64 * alert.u
            y: 56 * alert.u
            width: parent.width - 2 * x
            spacing: 32 * alert.u

            Column {
                width: parent.width
                spacing: 16 * alert.u

                AlertText {
                    stage: alert.stage
                    text: alert.look.title
                    size: 42
                    font.bold: true
                    color: "#16191f"
                }
                AlertText {
                    stage: alert.stage
                    text: alert.look.message
                    size: 33
                    isBalanced: true
                    color: alert.look.title !== "" ? "#3a414d" : "#16191f"
                }
            }
            AlertField {
                stage: alert.stage
                look: alert.look
                width: parent.width
                visible: look.hasField
            }
            Item {
                // The keys' own margins end at the field's edges.
                x: -4 * alert.u
                width: parent.width - 2 * x
                height: 5 * alert.capHeight
                visible: alert.look.hasField

                // The keyboard is named by what is typed with it.
                Accessible.role: Accessible.Grouping
                Accessible.name: alert.look.placeholder
                Accessible.ignored: !visible

                Repeater {
                    id: caps
                    model: alert.look.hasField ? alert.stage.keyboard.length : 0
                    delegate: KeyCap {
                        required property int index

                        stage: alert.stage
                        look: alert.stage.keyboard[index]
                        x: look ? look.column * alert.capWidth : 0
                        y: look ? look.row * alert.capHeight : 0
                        width: look ? look.width * alert.capWidth : 0
                        height: alert.capHeight
                    }
                }
            }
            // One below the other; under a keyboard side by side, as wide as it together.
            Grid {
                x: -12 * alert.u
                width: parent.width - 2 * x
                columns: alert.look.hasField ? Math.max(1, alert.look.actions.length) : 1
                rowSpacing: 12 * alert.u

                Repeater {
                    id: actions
                    model: alert.look.actions.length
                    delegate: ActionButton {
                        required property int index

                        stage: alert.stage
                        look: alert.look.actions[index]
                        width: parent ? parent.width / parent.columns : 0
                    }
                }
            }
        }
    }
}
