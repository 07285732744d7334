import QtQuick

Text {
    required property var stage
    readonly property real u: stage.unit

    width: parent.width
    visible: text !== ""
    textFormat: Text.PlainText
    wrapMode: Text.Wrap
    maximumLineCount: 5
    elide: Text.ElideRight
    horizontalAlignment: Text.AlignHCenter
    font.family: stage.fontFamily
    font.hintingPreference: Font.PreferNoHinting

    Accessible.role: Accessible.StaticText
    Accessible.name: text
    Accessible.ignored: !visible
}
