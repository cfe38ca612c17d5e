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
    readonly property string checkFailed:
        "Checking for updates failed. Please make sure USB drive has been prepared properly."
    property var scene

    function cleanup() {
        translator.setLanguage("en")
    }

    function findItem(item, matches) {
        for (var i = 0; i < item.children.length; ++i) {
            var found = matches(item.children[i]) ? item.children[i] : findItem(item.children[i], matches)
            if (found)
                return found
        }
        return null
    }

    // What a person sees of the scene: the title, the page and the box.
    function startScene() {
        initCalls.clear()
        updateCalls.clear()
        deinitCalls.clear()
        var component = Qt.createComponent("qrc:/main.qml")
        compare(component.status, Component.Ready, component.errorString())
        var window = createTemporaryObject(component, testCase)
        waitForRendering(window.contentItem)
        scene = {
            title: findItem(window.contentItem, function (item) { return item.elide !== undefined }),
            pages: findItem(window.contentItem, function (item) { return item.currentIndex !== undefined }),
            box: findItem(window.contentItem, function (item) { return item.acceptButtonText !== undefined })
        }
    }

    // The box's visible buttons, reject before accept, as laid out on the next polish.
    function shownButtons() {
        var row = scene.box.contentPositioner.children[2]
        waitForItemPolished(row)
        return [row.children[0], row.children[1]].filter(function (button) { return button.visible })
    }

    function buttonTexts() {
        return shownButtons().map(function (button) { return button.text })
    }

    function press(text) {
        mouseClick(shownButtons().filter(function (button) { return button.text === text })[0])
    }

    // An unknown error changes nothing at all.
    function test_startsOnTheCheckingPageAndStartsTheEngineOnce() {
        startScene()
        updateManager.error(7)
        compare([scene.pages.currentIndex, initCalls.count, updateCalls.count, deinitCalls.count, scene.box.visible,
                 scene.title.text], [0, 1, 0, 0, false, "KAVOR Networks Updater"])
    }

    function test_eachOutcomeOpensItsBox_data() {
        var info = "qrc:/information.svg", warning = "qrc:/warning.svg", close = ["CLOSE"]
        return [
            { tag: "updateFound", argument: "Marlix IV", icon: info, text: question.arg("Marlix IV"), buttons: ["NO", "YES"] },
            { tag: "noUpdate", icon: info, text: "No updates found.", buttons: close },
            { tag: "updateFinished", icon: info, text: "Software update successfully installed.", buttons: close },
            { tag: "checkUpdateFailed", icon: warning, text: checkFailed, buttons: close },
            { tag: "updateMirrorsFailed", icon: warning, text: checkFailed, buttons: close },
            { tag: "updateFailed", icon: warning, text: "Installing of update failed. Please try again later.",
              buttons: close }
        ]
    }

    function test_eachOutcomeOpensItsBox(data) {
        startScene()
        updateManager[data.tag](data.argument)
        compare([scene.box.visible, String(scene.box.icon), scene.box.text, buttonTexts(), scene.pages.currentIndex],
                [true, data.icon, data.text, data.buttons, 0])
        // One button spans the row, the box less its 20 pixel margins; two share it around a 40 pixel gap.
        var half = (scene.box.width - 80) / 2
        compare(shownButtons().map(function (button) { return [button.x, button.width] }),
                data.buttons.length === 1 ? [[0, scene.box.width - 40]] : [[0, half], [half + 40, half]])
    }

    // Each answer closes the box, switches the page and asks the engine once;
    // the result of an installation offers CLOSE alone.
    function test_theAnswersSwitchPagesAndDriveTheEngine_data() {
        return [
            { tag: "YES", signals: ["updateFound"], answers: ["YES"], page: 1, updates: 1, deinits: 0 },
            { tag: "NO", signals: ["updateFound"], answers: ["NO"], page: 2, updates: 0, deinits: 1 },
            { tag: "CLOSE", signals: ["noUpdate"], answers: ["CLOSE"], page: 2, updates: 0, deinits: 1 },
            { tag: "YES, CLOSE", signals: ["updateFound", "updateFailed"], answers: ["YES", "CLOSE"], page: 2, updates: 1,
              deinits: 1 }
        ]
    }

    function test_theAnswersSwitchPagesAndDriveTheEngine(data) {
        startScene()
        for (var i = 0; i < data.signals.length; ++i) {
            updateManager[data.signals[i]]("")
            if (i > 0)
                compare(buttonTexts(), ["CLOSE"])
            press(data.answers[i])
        }
        compare([scene.box.visible, scene.pages.currentIndex, updateCalls.count, deinitCalls.count, initCalls.count],
                [false, data.page, data.updates, data.deinits, 1])
    }

    function test_frenchTranslatesAllButTheQuestion() {
        translator.setLanguage("fr")
        startScene()
        updateManager.noUpdate()
        compare([scene.title.text, scene.box.text, buttonTexts()],
                ["Mise à jour KAVOR Networks", "Pas de mises à jour disponibles.", ["FERMER"]])
        press("FERMER")
        updateManager.updateFound("")
        compare([scene.box.text, buttonTexts()], [question.arg(""), ["NON", "OUI"]])
    }
}
