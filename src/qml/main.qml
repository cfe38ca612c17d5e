import QtQuick 2.11
import QtQuick.Window 2.11
import QtQuick.Controls 2.0
import QtQuick.Layouts 1.3
import QtQuick.Controls.Material 2.0
import "qrc:/components"

Window {
    id: root

    readonly property int pageCheckingSoftware: 0
    readonly property int pageInstallingSoftware: 1
    readonly property int pageClosingUpdater: 2

    function requestUpdate() {
        stackView.currentIndex = pageInstallingSoftware
        updateManager.update()
    }

    // The scene never quits by itself: the engine's wind-down stops the
    // updater's service, and that ends the process.
    function requestClose() {
        stackView.currentIndex = pageClosingUpdater
        updateManager.deinit()
    }

    // Every outcome ends in a box whose only button closes the updater:
    // there is no retry on the instrument's screen.
    function showResult(type, text) {
        messageBox.type = type
        messageBox.acceptButtonText = qsTr("CLOSE")
        messageBox.text = text
        messageBox.acceptFunction = requestClose
        messageBox.visible = true
    }

    visible: true
    width: 640
    height: 480
    visibility: Window.FullScreen

    Component.onCompleted: updateManager.init()

    Connections {
        target: updateManager

        onUpdateFound: {
            messageBox.type = MessageBox.Type.Info
            messageBox.acceptButtonText = qsTr("YES")
            messageBox.rejectButtonText = qsTr("NO")
            // The question is deliberately not in the catalogues.
            messageBox.text = "Software update has been found.\n\n%1\nDo you want to update?".arg(updatesText)
            messageBox.acceptFunction = requestUpdate
            messageBox.rejectFunction = requestClose
            messageBox.visible = true
        }
        onNoUpdate: showResult(MessageBox.Type.Info, qsTr("No updates found."))
        onUpdateFinished: showResult(MessageBox.Type.Info, qsTr("Software update successfully installed."))
        onCheckUpdateFailed: showResult(MessageBox.Type.Warning,
            qsTr("Checking for updates failed. Please make sure USB drive has been prepared properly."))
        onUpdateMirrorsFailed: showResult(MessageBox.Type.Warning,
            qsTr("Checking for updates failed. Please make sure USB drive has been prepared properly."))
        onUpdateFailed: showResult(MessageBox.Type.Warning, qsTr("Installing of update failed. Please try again later."))
    }

    ToolBar {
        id: titleBar

        height: 72
        Material.foreground: "#FFFFFF"
        anchors {
            top: parent.top
            left: parent.left
            right: parent.right
        }

        RowLayout {
            id: toolbarRowlayout

            anchors.fill: parent
            anchors.margins: 10
            spacing: 10

            Label {
                text: qsTr("KAVOR Networks Updater")
                font.pixelSize: 24
                elide: Text.ElideRight
                horizontalAlignment: Text.AlignLeft
                verticalAlignment: Text.AlignVCenter
                Layout.fillWidth: true
                Layout.fillHeight: true
            }
        }
    }

    StackLayout {
        id: stackView

        anchors {
            top: titleBar.bottom
            left: parent.left
            right: parent.right
            bottom: parent.bottom
        }

        LoadingComponent {
            text: qsTr("Checking software updates...\nPlease wait.\n")
        }
        LoadingComponent {
            text: qsTr("Installing software updates...\nPlease wait.\n")
        }
        LoadingComponent {
            text: qsTr("Closing updater application...\nPlease wait.\n")
        }
    }

    MessageBox {
        id: messageBox

        anchors {
            top: titleBar.bottom
            left: parent.left
            right: parent.right
            bottom: parent.bottom
        }
    }
}
