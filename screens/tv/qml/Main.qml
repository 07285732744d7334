import QtQuick

// The whole picture: 1920 by 1080 points in the middle of the window. It paints what the stage holds, at the
// places that it names; nothing here decides what is shown, where it stands or what has the focus. All lengths are
// points; the unit, `u`, says how many dots of the screen a point is.
Rectangle {
    id: root

    required property var stage

    // Whether anything is still on its way to where it belongs.
    function moves() {
        return table.moves() || bar.isMoving || alert.moves() || description.isMoving || status.isMoving
    }

    color: "#ffffff"

    Item {
        width: 1920 * root.stage.unit
        height: 1080 * root.stage.unit
        anchors.centerIn: parent

        TreeLabel {
            look: root.stage.title
            stage: root.stage
            Accessible.role: Accessible.Heading
        }
        WifiPicture {
            look: root.stage.image
            stage: root.stage
        }
        TreeLabel {
            id: description
            look: root.stage.description
            stage: root.stage
        }
        ProgressBar {
            id: bar
            look: root.stage.progress
            stage: root.stage
        }
        TreeLabel {
            id: status
            look: root.stage.status
            stage: root.stage
        }
        Table {
            id: table
            stage: root.stage
        }
        AlertPanel {
            id: alert
            anchors.fill: parent
            stage: root.stage
        }
    }
}
