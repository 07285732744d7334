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

    readonly property bool isMuted: look ? !look.isEnabled : false
    // Signs are drawn larger than words, which share their key with more letters.
    readonly property int fontSize: !look || !look.isFunction ? 34 : look.label.length > 1 ? 27 : 40
    readonly property real wantedFocus: look && look.isFocused ? 1 : 0
    readonly property bool isMoving: focusLook.opacity !== wantedFocus

    z: wantedFocus
    onWantedFocusChanged: if (wantedFocus) Qt.callLater(stage.tellFocus, cap)

    Rectangle {
        anchors.fill: parent
        anchors.margins: 4 * cap.u
        radius: 10 * cap.u
        color: !cap.look ? "white" : cap.look.isOn ? "#1b5fc1" : cap.look.isFunction ? "#d0d8e4" : "#e9edf3"
    }
    Rectangle {
        id: focusLook

        // Its label turns light with the ground, on its way too.
        readonly property bool isDark: opacity > 0.5 && !cap.isMuted

        anchors.fill: parent
        anchors.margins: cap.u * (4 - 8 * opacity)
        radius: 12 * cap.u
        color: cap.isMuted ? "#d5dce8" : "#16243a"
        border.width: cap.isMuted ? 4 * cap.u : 0
        border.color: "#66758e"
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
        font.pointSize: cap.u * cap.fontSize
        font.hintingPreference: Font.PreferNoHinting
        color: cap.isMuted ? "#6a7281" : focusLook.isDark || cap.look && cap.look.isOn ? "#ffffff" : "#16191f"
    }

    Accessible.role: Accessible.Button
    Accessible.ignored: !stage.alert.isShown
    Accessible.name: look ? look.name : ""
    Accessible.focusable: true
    Accessible.focused: wantedFocus === 1
}
