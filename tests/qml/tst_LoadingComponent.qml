import QtQuick 2.11
import QtTest 1.2
import "qrc:/components"

TestCase {
    id: testCase

    name: "LoadingComponent"
    when: windowShown

    Component {
        id: pageComponent

        LoadingComponent { text: "Please wait.\n" }
    }

    function test_theDotsGrowOnceASecondToThreeThenStartAgainUntilSwitchedOff() {
        var page = createTemporaryObject(pageComponent, testCase)
        var created = Date.now()
        tryCompare(page, "basicModeMessage", ".", 3000)
        verify(Date.now() - created >= 900, "first dot after " + (Date.now() - created) + " ms")
        page.enableBasicAnimation = false
        wait(1500)
        var shown = [page.textObj.text]
        for (var tick = 0; tick < 4; ++tick) {
            page.resources[0].triggered()
            shown.push(page.textObj.text)
        }
        compare(shown, ["Please wait.\n.", "Please wait.\n..", "Please wait.\n...", "Please wait.\n", "Please wait.\n."])
    }
}
