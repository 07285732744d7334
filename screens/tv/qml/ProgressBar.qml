import QtQuick

Rectangle {
    id: bar

    required property var look
    required property var stage
    readonly property real u: stage.unit

    // Told to screen readers, by this name.
    readonly property int percentage: Math.round(100 * look.fraction)
    onPercentageChanged: stage.tellValue(bar, percentage)

    readonly property bool isMoving: opacity !== (look.isShown ? 1 : 0) || fill.width !== fill.wanted

    x: u * look.frame.x
    y: u * look.frame.y
    width: u * look.frame.width
    height: u * look.frame.height
    radius: height / 2
    color: look.track

    opacity: look.isShown ? 1 : 0
    visible: opacity > 0
    Behavior on opacity {
        enabled: bar.stage.hasMotion
        NumberAnimation { duration: 200 }
    }

    Rectangle {
        id: fill

        readonly property real wanted: bar.look.fraction > 0 ? Math.max(height, bar.width * bar.look.fraction) : 0

        width: wanted
        height: parent.height
        radius: height / 2
        visible: width > 0
        color: "#1b5fc1"
        Behavior on width {
            enabled: bar.stage.hasMotion
            NumberAnimation { duration: 200 }
        }
    }

    Accessible.role: Accessible.ProgressBar
    Accessible.name: stage.status.text
    Accessible.ignored: !look.isShown
}
