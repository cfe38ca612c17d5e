import QtQuick 2.11
import QtTest 1.2
import "qrc:/components"

TestCase {
    id: testCase

    name: "LoadingComponent"
    when: windowShown
    width: 640
    height: 480

    Component {
        id: pageComponent

        LoadingComponent {
            anchors.fill: parent
            text: "Please wait.\n"
        }
    }

    function dotsTimerOf(page) {
        for (var i = 0; i < page.resources.length; ++i) {
            if (page.resources[i].interval !== undefined)
                return page.resources[i]
        }
        return null
    }

    function test_theDotsGrowToThreeThenStartAgain() {
        var page = createTemporaryObject(pageComponent, testCase, { enableBasicAnimation: false })
        var timer = dotsTimerOf(page)
        var shown = [page.textObj.text]
        for (var tick = 0; tick < 5; ++tick) {
            timer.triggered()
            shown.push(page.textObj.text)
        }
        compare(shown, ["Please wait.\n", "Please wait.\n.", "Please wait.\n..", "Please wait.\n...",
                        "Please wait.\n", "Please wait.\n."])
    }

    function test_theDotsAdvanceOnceASecondUntilSwitchedOff() {
        var created = Date.now()
        var page = createTemporaryObject(pageComponent, testCase)
        tryCompare(page, "basicModeMessage", ".", 3000)
        var firstDot = Date.now()
        tryCompare(page, "basicModeMessage", "..", 3000)
        verify(firstDot - created >= 900, "first dot after " + (firstDot - created) + " ms")
        verify(Date.now() - firstDot >= 900, "second dot after " + (Date.now() - firstDot) + " ms")

        page.enableBasicAnimation = false
        wait(1500)
        compare(page.basicModeMessage, "..")
        page.enableBasicAnimation = true
        tryCompare(page, "basicModeMessage", "...", 3000)
    }
}
