import QtQuick

// The picture "wifi".
Image {
    required property var look
    required property var stage
    readonly property real u: stage.unit

    x: u * look.frame.x
    y: u * look.frame.y
    width: u * look.frame.width
    height: u * look.frame.height
    visible: look.isShown
    source: look.name ? "qrc:/tv/pictures/" + look.name + ".png" : ""
    fillMode: Image.PreserveAspectFit
    smooth: true

    Accessible.ignored: true
}
