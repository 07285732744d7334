import QtQuick

// A row or a section's title.
Item {
    id: line

    required property var stage
    readonly property real u: stage.unit
    required property int lineId
    required property string text
    required property string detail
    required property bool isBlock
    required property bool isHeader
    required property bool isEnabled
    required property bool isFirst
    required property bool isLast
    required property real lineTop
    required property real lineHeight
    required property bool isFocused
    required property bool isNew
    required property bool isLeaving

    // Whether the select key works on it now: told to screen readers, by this name.
    readonly property bool isUsable: isHeader || isEnabled && !stage.table.isMuted
    onIsUsableChanged: stage.tellUse(line)

    property bool isThere: !isNew
    readonly property bool isMuted: stage.table.isMuted
    // Where the whole table is pale its rows need no paler ink of their own.
    readonly property bool isPale: stage.table.opacity === 1 && (isMuted || !isEnabled)
    readonly property color ink: isPale && !(isFocused && isMuted) ? "#6a7281" : "#16191f"
    readonly property real wantedOpacity: isLeaving || !isThere ? 0 : 1
    readonly property bool isMoving: opacity !== wantedOpacity || y !== u * lineTop || focusLook.isMoving

    y: u * lineTop
    height: u * lineHeight
    opacity: wantedOpacity
    z: isFocused ? 1 : isLeaving ? -1 : 0
    onIsFocusedChanged: if (isFocused) Qt.callLater(stage.tellFocus, line)

    Behavior on opacity {
        enabled: line.stage.hasMotion
        NumberAnimation { duration: 200 }
    }
    Behavior on y {
        enabled: line.stage.hasMotion && line.isThere
        NumberAnimation { duration: 200; easing.type: Easing.OutCubic }
    }
    onOpacityChanged: if (isLeaving && opacity === 0) stage.lines.release(lineId)
    // One that nobody has seen yet has nothing to fade from.
    onIsLeavingChanged: if (isLeaving && opacity === 0) stage.lines.release(lineId)
    Component.onCompleted: {
        isThere = true
        if (isFocused) Qt.callLater(stage.tellFocus, line)
    }

    // The ground of a row. It does not shine through the focus of a table at half opacity.
    Rectangle {
        visible: !line.isHeader && focusLook.opacity < 1
        anchors.fill: parent
        anchors.leftMargin: 12 * line.u
        anchors.rightMargin: 12 * line.u
        anchors.topMargin: 3 * line.u
        anchors.bottomMargin: 3 * line.u
        radius: 12 * line.u
        color: "#e9edf3"
    }

    // The focus: a dark ground that grows to every side; a pale one with an edge while nothing can be chosen.
    Rectangle {
        id: focusLook

        readonly property real wanted: line.isFocused ? 1 : 0
        readonly property color wantedColor: line.isMuted ? "#d5dce8" : "#16243a"
        readonly property bool isMoving: opacity !== wanted || visible && !Qt.colorEqual(color, wantedColor)
        // Its texts turn light with the ground, on its way too.
        readonly property bool isDark: opacity > 0.5 && color.hslLightness < 0.5

        visible: opacity > 0
        anchors.fill: parent
        anchors.leftMargin: 12 * line.u * (1 - opacity)
        anchors.rightMargin: 12 * line.u * (1 - opacity)
        anchors.topMargin: line.u * (3 - 6 * opacity)
        anchors.bottomMargin: line.u * (3 - 6 * opacity)
        radius: 14 * line.u
        color: wantedColor
        border.width: line.isMuted ? 4 * line.u : 0
        border.color: "#66758e"
        opacity: wanted
        Behavior on opacity {
            enabled: line.stage.hasMotion && line.isThere
            NumberAnimation { duration: 120 }
        }
        Behavior on color {
            enabled: line.stage.hasMotion
            ColorAnimation { duration: 150 }
        }
    }

    Loader {
        active: line.isBlock
        x: line.u * 40
        y: line.u * 18
        width: line.width - 2 * x
        sourceComponent: BlockText {
            stage: line.stage
            text: line.text
            detail: line.detail
            isLight: focusLook.isDark
        }
    }
    Text {
        visible: !line.isBlock
        x: line.u * 40
        width: line.width - 2 * x
        height: line.height - (line.isHeader ? 8 * line.u : 0)
        verticalAlignment: line.isHeader ? Text.AlignBottom : Text.AlignVCenter
        horizontalAlignment: Text.AlignLeft
        text: line.text
        textFormat: Text.PlainText
        elide: Text.ElideRight
        maximumLineCount: 1
        font.family: line.stage.fontFamily
        font.pointSize: line.u * (line.isHeader ? 24 : 32)
        font.bold: line.isHeader
        font.hintingPreference: Font.PreferNoHinting
        color: line.isHeader ? "#4f5866" : focusLook.isDark ? "#ffffff" : line.ink
    }

    Accessible.role: isHeader ? Accessible.Heading : Accessible.ListItem
    Accessible.name: text
    Accessible.description: detail
    Accessible.focusable: !isHeader
    Accessible.focused: isFocused
    Accessible.ignored: isLeaving
}
