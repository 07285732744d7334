import QtQuick

Item {
    id: button

    required property var stage
    readonly property real u: stage.unit
    required property var look

    // Told to screen readers, by this name.
    readonly property bool isUsable: look ? look.isEnabled : false
    onIsUsableChanged: stage.tellUse(button)

    readonly property bool isMuted: look ? !look.isEnabled : false
    readonly property real wantedFocus: look && look.isFocused ? 1 : 0
    readonly property bool isMoving: focusLook.opacity !== wantedFocus

    height: 78 * u
    onWantedFocusChanged: if (wantedFocus) Qt.callLater(stage.tellFocus, button)

    Rectangle {
        anchors.fill: parent
        anchors.leftMargin: 12 * button.u
        anchors.rightMargin: 12 * button.u
        anchors.topMargin: 3 * button.u
        anchors.bottomMargin: 3 * button.u
        radius: 12 * button.u
        color: "#e9edf3"
    }
    Rectangle {
        id: focusLook

        // Its text turns light with the ground, on its way too.
        readonly property bool isDark: opacity > 0.5 && !button.isMuted

        anchors.fill: parent
        anchors.leftMargin: 12 * button.u * (1 - opacity)
        anchors.rightMargin: 12 * button.u * (1 - opacity)
        anchors.topMargin: button.u * (3 - 6 * opacity)
        anchors.bottomMargin: button.u * (3 - 6 * opacity)
        radius: 14 * button.u
        color: button.isMuted ? "#d5dce8" : "#16243a"
        border.width: button.isMuted ? 4 * button.u : 0
        border.color: "#66758e"
        opacity: button.wantedFocus
        visible: opacity > 0
        Behavior on opacity {
            enabled: button.stage.hasMotion
            NumberAnimation { duration: 120 }
        }
    }
    Text {
        anchors.fill: parent
        anchors.leftMargin: 40 * button.u
        anchors.rightMargin: 40 * button.u
        horizontalAlignment: Text.AlignHCenter
        verticalAlignment: Text.AlignVCenter
        text: button.look ? button.look.title : ""
        textFormat: Text.PlainText
        elide: Text.ElideRight
        font.family: button.stage.fontFamily
        font.pointSize: button.u * 32
        font.hintingPreference: Font.PreferNoHinting
        color: !button.look ? "black" : button.isMuted ? "#6a7281" : focusLook.isDark ? "#ffffff" : "#16191f"
    }

    Accessible.role: Accessible.Button
    Accessible.ignored: !stage.alert.isShown
    Accessible.name: look ? look.title : ""
    Accessible.focusable: true
    Accessible.focused: look ? look.isFocused : false
}
