import QtQuick

// The texts of a row that takes several lines: what it says, and below it the detail.
Column {
    id: block

    required property var stage
    readonly property real u: stage.unit
    required property string text
    required property string detail
    required property bool isLight

    spacing: 6 * u

    Text {
        width: parent.width
        text: block.text
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        horizontalAlignment: Text.AlignLeft
        font.family: block.stage.fontFamily
        font.pointSize: block.u * 32
        font.hintingPreference: Font.PreferNoHinting
        color: block.isLight ? "#ffffff" : "#16191f"
    }
    Text {
        width: parent.width
        visible: text !== ""
        text: block.detail
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        horizontalAlignment: Text.AlignLeft
        font.family: block.stage.fontFamily
        font.pointSize: block.u * 28
        font.hintingPreference: Font.PreferNoHinting
        color: block.isLight ? "#d5dce8" : "#4f5866"
    }
}
