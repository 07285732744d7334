import QtQuick

// A key of the keyboard on the screen.
Item {
    id: cap

    required property var stage
    readonly property real u: stage.unit
    required property var look

    // Told to screen readers, by this name.
    readonly property bool isUsable: look ? look.isEnabled : false
    onIsUsableChanged: stage.tellUse(cap)

    readonly property real wantedFocus: look && look.isFocused ? 1 : 0
    readonly property bool isMoving: focusLook.opacity !== wantedFocus

    z: wantedFocus
    onWantedFocusChanged: if (wantedFocus) Qt.callLater(stage.tellFocus, cap)

    Rectangle {
        anchors.fill: parent
        anchors.margins: 4 * cap.u
        radius: 10 * cap.u
        color: cap.look && (cap.look.isOn || cap.look.isFunction) ? (cap.look.isOn ? "#b9c8e2" : "#d9dee7") : "#eef1f5"
    }
    Rectangle {
        id: focusLook

        anchors.fill: parent
        anchors.margins: cap.u * (4 - 8 * opacity)
        radius: 12 * cap.u
        color: cap.look && cap.look.isEnabled ? "#16243a" : "#8b93a1"
        opacity: cap.wantedFocus
        visible: opacity > 0
        Behavior on opacity {
            enabled: cap.stage.hasMotion
            NumberAnimation { duration: 90 }
        }
    }
    Text {
        anchors.fill: parent
        anchors.leftMargin: 10 * cap.u
        anchors.rightMargin: 10 * cap.u
        horizontalAlignment: Text.AlignHCenter
        verticalAlignment: Text.AlignVCenter
        text: cap.look ? cap.look.label : ""
        textFormat: Text.PlainText
        elide: Text.ElideRight
        font.family: cap.stage.fontFamily
        font.pointSize: cap.u * (cap.look && cap.look.isFunction && cap.look.label.length > 2 ? 27 : 32)
        font.hintingPreference: Font.PreferNoHinting
        color: !cap.look ? "black" : cap.look.isFocused ? "#ffffff" : cap.look.isEnabled ? "#16191f" : "#767c87"
    }

    Accessible.role: Accessible.Button
    Accessible.ignored: !stage.alert.isShown
    Accessible.name: look ? look.name : ""
    Accessible.focusable: true
    Accessible.focused: wantedFocus === 1
}
