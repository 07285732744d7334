import QtQuick

Text {
    required property var stage
    required property int size
    property bool isBalanced: false
    readonly property real u: stage.unit
    readonly property real limit: parent.width / u

    anchors.horizontalCenter: parent.horizontalCenter
    width: u * (isBalanced ? stage.balancedWidth(text, size, limit) : limit)
    visible: text !== ""
    textFormat: Text.PlainText
    wrapMode: Text.Wrap
    maximumLineCount: 5
    elide: Text.ElideRight
    horizontalAlignment: Text.AlignHCenter
    font.family: stage.fontFamily
    font.pointSize: u * size
    font.hintingPreference: Font.PreferNoHinting

    Accessible.role: Accessible.StaticText
    Accessible.name: text
    Accessible.ignored: !visible
}
