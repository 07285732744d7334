import QtQuick

// Hides what is behind it the more the nearer it is to the upper edge: more follows there.
Rectangle {
    id: veil

    required property var stage
    required property bool isShown
    readonly property bool isMoving: opacity !== (isShown ? 1 : 0)

    width: parent.width
    height: 60 * stage.unit
    opacity: isShown ? 1 : 0
    visible: opacity > 0
    gradient: Gradient {
        GradientStop { position: 0; color: "#ffffffff" }
        GradientStop { position: 1; color: "#00ffffff" }
    }
    Behavior on opacity {
        enabled: veil.stage.hasMotion
        NumberAnimation { duration: 160 }
    }
}
