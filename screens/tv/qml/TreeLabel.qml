import QtQuick

// A label of the tree. It fades when it comes and goes.
Text {
    id: label

    required property var look
    required property var stage
    readonly property real u: stage.unit

    readonly property bool isMoving: opacity !== (look.isShown ? 1 : 0)

    x: u * look.frame.x
    y: u * look.frame.y
    width: u * look.frame.width
    // Centred lines are about as long as each other.
    readonly property real spare: look.lines !== 1 && look.alignment === Text.AlignHCenter
        ? look.frame.width - stage.balancedWidth(look.text, look.fontSize, look.frame.width) : 0
    leftPadding: u * spare / 2
    rightPadding: u * spare / 2
    text: look.text
    color: look.color
    textFormat: Text.PlainText
    font.family: stage.fontFamily
    // Rounded down to dots, so that the text takes no more than the frame that was measured for it.
    font.pointSize: Math.max(1, Math.floor(u * look.fontSize))
    font.hintingPreference: Font.PreferNoHinting
    horizontalAlignment: look.alignment
    wrapMode: look.lines === 1 ? Text.NoWrap : Text.Wrap
    maximumLineCount: look.lines > 0 ? look.lines : 1000
    elide: Text.ElideRight

    opacity: look.isShown ? 1 : 0
    visible: opacity > 0
    Behavior on opacity {
        enabled: label.stage.hasMotion
        NumberAnimation { duration: 200 }
    }

    Accessible.role: Accessible.StaticText
    Accessible.name: text
    Accessible.ignored: !look.isShown
}
