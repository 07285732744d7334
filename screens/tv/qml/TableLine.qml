import QtQuick

// A row or a section's title.
Item {
    id: line

    required property var stage
    readonly property real u: stage.unit
    required property int lineId
    required property string text
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
    readonly property real wantedOpacity: isLeaving || !isThere ? 0 : 1
    readonly property bool isMoving: opacity !== wantedOpacity || y !== u * lineTop || focusLook.opacity !== focusLook.wanted

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
    Component.onCompleted: {
        isThere = true
        if (isFocused) Qt.callLater(stage.tellFocus, line)
    }

    // The ground of a row; the rows of a group stand closer to each other than to the next group.
    Rectangle {
        visible: !line.isHeader
        x: 12 * line.u
        y: line.isFirst ? 3 * line.u : 0
        width: line.width - 2 * x
        height: line.height - y - (line.isLast ? 3 : 2) * line.u
        radius: 10 * line.u
        color: "#eff1f5"
    }

    // The focus: a dark ground, 12 points wider on either side.
    Rectangle {
        id: focusLook

        readonly property real wanted: line.isFocused ? 1 : 0

        visible: opacity > 0
        anchors.fill: parent
        anchors.leftMargin: 12 * line.u * (1 - opacity)
        anchors.rightMargin: 12 * line.u * (1 - opacity)
        radius: 12 * line.u
        color: line.stage.table.isMuted ? "#8b93a1" : "#16243a"
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

    Text {
        x: line.u * (line.isHeader ? 28 : 40)
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
        font.hintingPreference: Font.PreferNoHinting
        color: line.isHeader ? "#5a6270" : line.isFocused ? "#ffffff" : line.isEnabled ? "#16191f" : "#767c87"
    }

    Accessible.role: isHeader ? Accessible.Heading : Accessible.ListItem
    Accessible.name: text
    Accessible.focusable: !isHeader
    Accessible.focused: isFocused
    Accessible.ignored: isLeaving
}
