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
    text: look.text
    color: look.color
    textFormat: Text.PlainText
    font.family: stage.fontFamily
    font.pointSize: u * look.fontSize
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
