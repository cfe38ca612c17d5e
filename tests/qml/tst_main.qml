import QtQuick 2.11
import QtTest 1.2

TestCase {
    id: testCase

    name: "Scene"
    when: windowShown

    SignalSpy { id: initCalls; target: updateManager; signalName: "initCalled" }
    SignalSpy { id: updateCalls; target: updateManager; signalName: "updateCalled" }
    SignalSpy { id: deinitCalls; target: updateManager; signalName: "deinitCalled" }

    readonly property string question: "Software update has been found.\n\n%1\nDo you want to update?"
    readonly property string checkFailedText:
        "Checking for updates failed. Please make sure USB drive has been prepared properly."

    function cleanup() {
        translator.setLanguage("en")
    }

    function findItem(item, matches) {
        for (var i = 0; i < item.children.length; ++i) {
            var child = item.children[i]
            if (matches(child))
                return child
            var inside = findItem(child, matches)
            if (inside)
                return inside
        }
        return null
    }

    function visibleButtons(item) {
        var found = []
        for (var i = 0; i < item.children.length; ++i) {
            var child = item.children[i]
            if (child.flat !== undefined && child.visible)
                found.push(child)
            found = found.concat(visibleButtons(child))
        }
        return found
    }

    // What a person sees of the scene: the title, the page and the box.
    function sceneOf(window) {
        var titleBar = findItem(window.contentItem, function (item) { return item.position !== undefined })
        return {
            title: findItem(titleBar, function (item) { return item.elide !== undefined }),
            pages: findItem(window.contentItem, function (item) { return item.currentIndex !== undefined }),
            box: findItem(window.contentItem, function (item) { return item.acceptButtonText !== undefined })
        }
    }

    // The button row is laid out on the next polish; a person only ever sees
    // the laid-out row.
    function shownButtons(scene) {
        waitForItemPolished(scene.box.contentPositioner.children[2])
        return visibleButtons(scene.box)
    }

    function buttonTexts(scene) {
        return shownButtons(scene).map(function (button) { return button.text })
    }

    function press(scene, text) {
        var button = shownButtons(scene).filter(function (button) { return button.text === text })[0]
        verify(button, "no visible button " + text)
        mouseClick(button)
    }

    function startScene() {
        initCalls.clear()
        updateCalls.clear()
        deinitCalls.clear()
        var component = Qt.createComponent("qrc:/main.qml")
        compare(component.status, Component.Ready, component.errorString())
        var window = createTemporaryObject(component, testCase)
        verify(window)
        waitForRendering(window.contentItem)
        return sceneOf(window)
    }

    function test_startsOnTheCheckingPageAndStartsTheEngineOnce() {
        var scene = startScene()
        compare(scene.pages.currentIndex, 0)
        compare(initCalls.count, 1)
        verify(!scene.box.visible)
        compare(scene.title.text, "KAVOR Networks Updater")
    }

    function test_eachOutcomeOpensItsBox_data() {
        return [
            { tag: "update found", signal: "updateFound", argument: "", icon: "qrc:/information.svg",
              text: question.arg(""), buttons: ["NO", "YES"] },
            { tag: "update found with a description", signal: "updateFound", argument: "Marlix IV 4.2",
              icon: "qrc:/information.svg", text: question.arg("Marlix IV 4.2"), buttons: ["NO", "YES"] },
            { tag: "no update", signal: "noUpdate", icon: "qrc:/information.svg",
              text: "No updates found.", buttons: ["CLOSE"] },
            { tag: "update finished", signal: "updateFinished", icon: "qrc:/information.svg",
              text: "Software update successfully installed.", buttons: ["CLOSE"] },
            { tag: "check failed", signal: "checkUpdateFailed", icon: "qrc:/warning.svg",
              text: checkFailedText, buttons: ["CLOSE"] },
            { tag: "mirrors failed", signal: "updateMirrorsFailed", icon: "qrc:/warning.svg",
              text: checkFailedText, buttons: ["CLOSE"] },
            { tag: "update failed", signal: "updateFailed", icon: "qrc:/warning.svg",
              text: "Installing of update failed. Please try again later.", buttons: ["CLOSE"] }
        ]
    }

    function test_eachOutcomeOpensItsBox(data) {
        var scene = startScene()
        if (data.signal === "updateFound")
            updateManager.updateFound(data.argument)
        else
            updateManager[data.signal]()

        verify(scene.box.visible)
        compare(String(scene.box.icon), data.icon)
        compare(scene.box.text, data.text)
        compare(buttonTexts(scene), data.buttons)
        compare(scene.pages.currentIndex, 0)
    }

    function test_theAnswersSwitchPagesAndDriveTheEngine_data() {
        return [
            { tag: "YES", signal: "updateFound", answer: "YES", page: 1, updates: 1, deinits: 0 },
            { tag: "NO", signal: "updateFound", answer: "NO", page: 2, updates: 0, deinits: 1 },
            { tag: "CLOSE", signal: "noUpdate", answer: "CLOSE", page: 2, updates: 0, deinits: 1 }
        ]
    }

    function test_theAnswersSwitchPagesAndDriveTheEngine(data) {
        var scene = startScene()
        updateManager[data.signal]("")
        press(scene, data.answer)

        verify(!scene.box.visible)
        compare(scene.pages.currentIndex, data.page)
        compare(updateCalls.count, data.updates)
        compare(deinitCalls.count, data.deinits)
        compare(initCalls.count, 1)
    }

    function test_theResultOfAnInstallationOffersOnlyClose() {
        var scene = startScene()
        updateManager.updateFound("")
        press(scene, "YES")
        updateManager.updateFailed()

        compare(buttonTexts(scene), ["CLOSE"])
        press(scene, "CLOSE")
        compare(scene.pages.currentIndex, 2)
        compare(deinitCalls.count, 1)
    }

    function test_anUnknownErrorChangesNothing() {
        var scene = startScene()
        updateManager.error(7)
        verify(!scene.box.visible)
        compare(scene.pages.currentIndex, 0)
        compare(updateCalls.count + deinitCalls.count, 0)
    }

    function test_frenchTranslatesAllButTheQuestion() {
        translator.setLanguage("fr")
        var scene = startScene()
        compare(scene.title.text, "Mise à jour KAVOR Networks")

        updateManager.noUpdate()
        compare(scene.box.text, "Pas de mises à jour disponibles.")
        compare(buttonTexts(scene), ["FERMER"])
        press(scene, "FERMER")

        updateManager.updateFound("")
        compare(scene.box.text, question.arg(""))
        compare(buttonTexts(scene), ["NON", "OUI"])
    }
}
