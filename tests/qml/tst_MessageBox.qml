import QtQuick 2.11
import QtTest 1.2
import "qrc:/components"

TestCase {
    id: testCase

    name: "MessageBox"
    when: windowShown
    // The boxes are children of the test case: it must be visible for theirs.
    visible: true
    width: 640
    height: 480

    Component {
        id: boxComponent

        MessageBox {
            anchors.fill: parent
        }
    }

    function buttonsOf(item) {
        var found = []
        for (var i = 0; i < item.children.length; ++i) {
            var child = item.children[i]
            if (child.flat !== undefined && child.visible)
                found.push(child)
            found = found.concat(buttonsOf(child))
        }
        return found
    }

    // The button row is laid out on the next polish; a person only ever sees
    // the laid-out row.
    function visibleButtonsOf(box) {
        waitForItemPolished(box.contentPositioner.children[2])
        return buttonsOf(box)
    }

    function buttonTexts(box) {
        return visibleButtonsOf(box).map(function (button) { return button.text })
    }

    function buttonNamed(box, text) {
        return visibleButtonsOf(box).filter(function (button) { return button.text === text })[0]
    }

    function createBox(properties) {
        var box = createTemporaryObject(boxComponent, testCase, properties)
        verify(box)
        waitForRendering(box)
        return box
    }

    function test_showsOneFullWidthButtonOrTwoSharingTheRow_data() {
        return [
            { tag: "no button", reject: "", accept: "", expected: [] },
            { tag: "accept only", reject: "", accept: "CLOSE", expected: ["CLOSE"] },
            { tag: "both", reject: "NO", accept: "YES", expected: ["NO", "YES"] }
        ]
    }

    function test_showsOneFullWidthButtonOrTwoSharingTheRow(data) {
        var box = createBox({ rejectButtonText: data.reject, acceptButtonText: data.accept, visible: true })
        compare(buttonTexts(box), data.expected)

        var buttons = visibleButtonsOf(box)
        var rowWidth = box.width - 40
        if (buttons.length === 1)
            compare(buttons[0].width, rowWidth)
        if (buttons.length === 2) {
            compare(buttons[0].width, buttons[1].width)
            compare(buttons[0].width + 40 + buttons[1].width, rowWidth)
            verify(buttons[0].x < buttons[1].x)
        }
    }

    function test_emptyingTheRejectTextHidesItsButtonAtOnce() {
        var box = createBox({ rejectButtonText: "NO", acceptButtonText: "YES", visible: true })
        box.rejectButtonText = ""
        compare(buttonTexts(box), ["YES"])
    }

    function test_aPressHidesTheBoxRunsItsFunctionAndResets_data() {
        return [
            { tag: "accept", press: "YES", withFunctions: true, expected: ["accept while hidden"] },
            { tag: "reject", press: "NO", withFunctions: true, expected: ["reject while hidden"] },
            { tag: "accept without function", press: "YES", withFunctions: false, expected: [] }
        ]
    }

    function test_aPressHidesTheBoxRunsItsFunctionAndResets(data) {
        var calls = []
        var box = createBox({ type: 1, rejectButtonText: "NO", acceptButtonText: "YES", text: "Go on?" })
        if (data.withFunctions) {
            box.acceptFunction = function () { calls.push(box.visible ? "accept while shown" : "accept while hidden") }
            box.rejectFunction = function () { calls.push(box.visible ? "reject while shown" : "reject while hidden") }
        }
        box.visible = true
        waitForRendering(box)

        mouseClick(buttonNamed(box, data.press))

        compare(calls, data.expected)
        verify(!box.visible)
        compare(box.type, 0)
        compare(box.text, "")
        compare(box.acceptButtonText, "")
        compare(box.rejectButtonText, "")
        compare(box.acceptFunction, null)
        compare(box.rejectFunction, null)
    }

    function test_picksItsIconByType_data() {
        return [
            { tag: "Info", type: 0, icon: "qrc:/information.svg" },
            { tag: "Warning", type: 1, icon: "qrc:/warning.svg" },
            { tag: "Question", type: 2, icon: "qrc:/question.svg" },
            { tag: "unknown", type: 3, icon: "qrc:/information.svg", warning: "Unexpected type: 3" }
        ]
    }

    function test_picksItsIconByType(data) {
        var box = createBox({ type: 2 })
        if (data.warning)
            ignoreWarning(data.warning)
        box.type = data.type
        compare(String(box.icon), data.icon)
        // The icon really loads from the resources at the size it is shown.
        tryCompare(box.contentPositioner.children[0], "status", Image.Ready)
        compare(box.contentPositioner.children[0].paintedWidth, 200)
    }
}
