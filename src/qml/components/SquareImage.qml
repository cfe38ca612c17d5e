import QtQuick 2.7

// Vector icons are rasterised at the size they are shown, off the GUI thread.
Image {
    property int size: 48

    width: size
    height: size
    sourceSize.width: size
    sourceSize.height: size
    fillMode: Image.PreserveAspectFit
    asynchronous: true
    antialiasing: true
}
