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

        MessageBox { anchors.fill: parent }
    }

    // The visible buttons, reject before accept, as laid out on the next polish.
    function shownButtons(box) {
        waitForRendering(box)
        var row = box.contentPositioner.children[2]
        waitForItemPolished(row)
        return [row.children[0], row.children[1]].filter(function (button) { return button.visible })
    }

    function test_aPressHidesTheBoxRunsItsFunctionAndResets_data() {
        return [
            { tag: "accept", press: 1, withFunctions: true, expected: [["accept", false]] },
            { tag: "reject", press: 0, withFunctions: true, expected: [["reject", false]] },
            { tag: "accept without function", press: 1, withFunctions: false, expected: [] }
        ]
    }

    function test_aPressHidesTheBoxRunsItsFunctionAndResets(data) {
        var calls = []
        var box = createTemporaryObject(boxComponent, testCase,
                                        { type: 1, rejectButtonText: "NO", acceptButtonText: "YES", text: "Go on?" })
        if (data.withFunctions) {
            box.acceptFunction = function () { calls.push(["accept", box.visible]) }
            box.rejectFunction = function () { calls.push(["reject", box.visible]) }
        }
        box.visible = true
        mouseClick(shownButtons(box)[data.press])
        compare(calls, data.expected)
        compare([box.visible, box.type, box.text, box.acceptButtonText, box.rejectButtonText, box.acceptFunction,
                 box.rejectFunction], [false, 0, "", "", "", null, null])
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
        var box = createTemporaryObject(boxComponent, testCase, { type: 2 })
        if (data.warning)
            ignoreWarning(data.warning)
        box.type = data.type
        compare(String(box.icon), data.icon)
        // The icon really loads from the resources at the size it is shown.
        var image = box.contentPositioner.children[0]
        tryCompare(image, "status", Image.Ready)
        compare(image.paintedWidth, 200)
    }
}
