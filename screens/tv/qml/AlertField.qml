import QtQuick

// One line of text with its cursor; a longer text is shown from where the cursor is inside the field.
Rectangle {
    id: field

    required property var stage
    readonly property real u: stage.unit
    required property var look

    // While a key of the keyboard on the screen has the focus, a screen reader follows that one.
    readonly property bool isRead: look.isFieldFocused && !stage.keyboard.some(key => key.isFocused)

    // As the text is drawn, whose size is rounded to dots.
    readonly property real cursorX: look.textWidth > 0 ? typed.implicitWidth * look.cursorX / look.textWidth : 0

    onIsReadChanged: if (isRead) Qt.callLater(stage.tellFocus, field)

    height: 84 * u
    radius: 12 * u
    color: "#f1f3f7"
    border.width: u * (look.isFieldFocused ? 4 : 2)
    border.color: look.isFieldFocused ? "#16243a" : "#b9c0cc"

    Item {
        id: view

        x: 24 * field.u
        width: parent.width - 2 * x
        height: parent.height
        clip: true

        Text {
            id: typed

            x: Math.min(0, view.width - 4 * field.u - field.cursorX)
            height: parent.height
            verticalAlignment: Text.AlignVCenter
            horizontalAlignment: Text.AlignLeft
            text: field.look.text
            textFormat: Text.PlainText
            font.family: field.stage.fontFamily
            font.pointSize: field.u * 34
            font.hintingPreference: Font.PreferNoHinting
            color: "#16191f"
        }
        Text {
            x: 10 * field.u
            width: parent.width - x
            height: parent.height
            verticalAlignment: Text.AlignVCenter
            horizontalAlignment: Text.AlignLeft
            visible: field.look.text === ""
            text: field.look.placeholder
            textFormat: Text.PlainText
            elide: Text.ElideRight
            font.family: field.stage.fontFamily
            font.pointSize: field.u * 34
            font.hintingPreference: Font.PreferNoHinting
            color: "#6a7281"
        }
        // The text goes on beyond this edge.
        Rectangle {
            visible: typed.x < 0
            y: 8 * field.u
            width: 72 * field.u
            height: parent.height - 2 * y
            gradient: Gradient {
                orientation: Gradient.Horizontal
                GradientStop { position: 0; color: field.color }
                GradientStop { position: 1; color: "#00f1f3f7" }
            }
        }
        Rectangle {
            objectName: "cursor"
            x: typed.x + field.cursorX
            y: 16 * field.u
            width: 4 * field.u
            height: parent.height - 2 * y
            visible: field.look.isFieldFocused
            color: "#1b5fc1"
        }
    }

    Accessible.role: Accessible.EditableText
    Accessible.name: look.placeholder
    Accessible.description: look.text
    Accessible.editable: true
    Accessible.focusable: true
    Accessible.focused: isRead
    Accessible.ignored: !visible
}
