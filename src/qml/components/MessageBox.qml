import QtQuick 2.7
import QtQuick.Controls 2.0
import QtQuick.Layouts 1.3

Rectangle {
    id: root

    enum Type {
        Info,
        Warning,
        Question
    }

    property alias icon: iconObject.source
    property alias text: labelObject.text
    property string infoIcon: "qrc:/information.svg"
    property string warningIcon: "qrc:/warning.svg"
    property string questionIcon: "qrc:/question.svg"
    property string acceptButtonText: ""
    property string rejectButtonText: ""
    property int type: MessageBox.Type.Info
    property var acceptFunction: null
    property var rejectFunction: null
    property alias contentPositioner: col

    // The box hides before the caller's function runs, and forgets everything
    // afterwards, so the next caller starts from a clean box.
    function acceptClicked() {
        root.visible = false
        if (acceptFunction !== null && acceptFunction !== undefined)
            acceptFunction()
        resetParams()
    }

    function rejectClicked() {
        root.visible = false
        if (rejectFunction !== null && rejectFunction !== undefined)
            rejectFunction()
        resetParams()
    }

    function resetParams() {
        acceptButtonText = ""
        rejectButtonText = ""
        text = ""
        type = MessageBox.Type.Info
        acceptFunction = null
        rejectFunction = null
    }

    function iconForType() {
        if (type === MessageBox.Type.Info)
            return infoIcon
        if (type === MessageBox.Type.Warning)
            return warningIcon
        if (type === MessageBox.Type.Question)
            return questionIcon
        console.warn("Unexpected type: %1".arg(type))
        return infoIcon
    }

    visible: false

    // While the box is up, nothing underneath may react to a touch.
    MouseArea {
        anchors.fill: parent
    }

    Column {
        id: col

        anchors.centerIn: parent
        width: root.width
        height: childrenRect.height
        spacing: 40

        SquareImage {
            id: iconObject

            anchors.horizontalCenter: parent.horizontalCenter
            size: 200
            source: root.iconForType()
        }

        Label {
            id: labelObject

            anchors {
                left: parent.left
                right: parent.right
                margins: 20
            }
            wrapMode: Text.WordWrap
            horizontalAlignment: Qt.AlignHCenter
            font.pixelSize: 24
        }

        RowLayout {
            anchors.horizontalCenter: parent.horizontalCenter
            width: labelObject.width
            spacing: 40

            Button {
                id: rejectButton

                text: root.rejectButtonText
                Layout.fillWidth: true
                font.pixelSize: 20
                visible: text.length > 0
                onClicked: root.rejectClicked()
            }

            Button {
                id: acceptButton

                text: root.acceptButtonText
                Layout.fillWidth: true
                font.pixelSize: 20
                visible: text.length > 0
                onClicked: root.acceptClicked()
            }
        }
    }
}
