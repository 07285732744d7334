import QtQuick

Item {
    id: button

    required property var stage
    readonly property real u: stage.unit
    required property var look

    // Told to screen readers, by this name.
    readonly property bool isUsable: look ? look.isEnabled : false
    onIsUsableChanged: stage.tellUse(button)

    readonly property real wantedFocus: look && look.isFocused ? 1 : 0
    readonly property bool isMoving: focusLook.opacity !== wantedFocus

    height: 72 * u
    onWantedFocusChanged: if (wantedFocus) Qt.callLater(stage.tellFocus, button)

    Rectangle {
        x: 12 * button.u
        y: 2 * button.u
        width: parent.width - 2 * x
        height: parent.height - 2 * y
        radius: 10 * button.u
        color: "#e7eaf0"
    }
    Rectangle {
        id: focusLook

        anchors.fill: parent
        anchors.leftMargin: 12 * button.u * (1 - opacity)
        anchors.rightMargin: 12 * button.u * (1 - opacity)
        radius: 12 * button.u
        color: button.look && button.look.isEnabled ? "#16243a" : "#8b93a1"
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
        color: !button.look ? "black" : button.look.isFocused ? "#ffffff" : button.look.isEnabled ? "#16191f" : "#767c87"
    }

    Accessible.role: Accessible.Button
    Accessible.ignored: !stage.alert.isShown
    Accessible.name: look ? look.title : ""
    Accessible.focusable: true
    Accessible.focused: look ? look.isFocused : false
}
