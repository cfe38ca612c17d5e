import QtQuick 2.7

Rectangle {
    id: root

    property alias text: textObject.textMessage
    property alias font: textObject.font
    property alias textColor: textObject.color
    property alias textObj: textObject
    property bool enableBasicAnimation: true
    property string basicModeMessage: ""

    // Growing dots show that the instrument is still busy: none, one, two,
    // three, then none again, one step a second.
    Timer {
        id: basicModeMessageTime

        property int triggeredCount: 0

        interval: 1000
        repeat: true
        running: root.enableBasicAnimation
        onTriggered: {
            triggeredCount += 1
            root.basicModeMessage += "."
            if (triggeredCount > 3) {
                triggeredCount = 0
                root.basicModeMessage = ""
            }
        }
    }

    Column {
        anchors.centerIn: parent
        width: root.width * 2 / 3
        spacing: 40

        Text {
            id: textObject

            property string textMessage: ""

            width: parent.width
            wrapMode: Text.WordWrap
            horizontalAlignment: Text.AlignHCenter
            font.pixelSize: 20
            text: textMessage + root.basicModeMessage
        }
    }
}
