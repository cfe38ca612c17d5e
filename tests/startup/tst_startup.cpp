#include <QProcess>
#include <QStandardPaths>
#include <QtTest>

#include <unistd.h>

#include <algorithm>
#include <filesystem>

#include "FakeInstrument.h"

namespace {

const QString unset = QStringLiteral("<unset>");

// One run of the real updater: a directory that becomes /home/quarn, a working directory,
// the fake instrument first on PATH, and the process, killed by its id when the run ends.
struct UpdaterRun
{
    QTemporaryDir home, work;
    FakeInstrument instrument;
    // Taken after the fake instrument has put itself first on PATH.
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    QProcess process;

    ~UpdaterRun()
    {
        process.kill();
        process.waitForFinished(10000);
    }
    void write(const QString &relative, const QByteArray &content)
    {
        QDir().mkpath(QFileInfo(home.filePath(relative)).path());
        QFile file(home.filePath(relative));
        QVERIFY(file.open(QIODevice::WriteOnly) && file.write(content) == content.size());
    }
    // No display and no GPU here: the scene is drawn in software.
    void start(const QString &platform = "offscreen")
    {
        environment.insert("QT_QPA_PLATFORM", platform);
        environment.insert("QT_QUICK_BACKEND", "software");
        environment.insert("QT_LOGGING_RULES", "default.debug=true;qt.qml.connections.warning=false");
        process.setProcessEnvironment(environment);
        process.setWorkingDirectory(work.path());
        process.start(RUN_IN_PRIVATE_HOME, {home.path(), UPDATER_EXECUTABLE});
        QVERIFY(process.waitForStarted());
    }
};

// The language shows only on the screen, which the minimal platform writes to the working directory
// on every repaint. While a page shows, its dots change it every second; a picture that stays the same
// across a tick is the warning box of the failed check, complete with its icon.
QImage settledScreen(const QString &storedLanguage)
{
    UpdaterRun run;
    if (storedLanguage != unset)
        run.write("language.ini", "[General]\nQuarnLanguage=" + storedLanguage.toUtf8() + "\n");
    run.environment.insert("QT_DEBUG_BACKINGSTORE", "1");
    run.start("minimal:enable_fonts");
    QDir frames(run.work.path(), "output*.png", QDir::Name, QDir::Files);
    QElapsedTimer waiting;
    waiting.start();
    while (waiting.elapsed() < 60000) {
        QTest::qWait(100);
        frames.refresh();
        const QFileInfoList names = frames.entryInfoList();
        // The newest file may still be being written; the two before it are whole.
        if (names.count() < 3)
            continue;
        const QFileInfo &last = names.at(names.count() - 2), &previous = names.at(names.count() - 3);
        const QImage picture(last.filePath());
        if (previous.lastModified().msecsTo(last.lastModified()) >= 500 && picture == QImage(previous.filePath()))
            return picture;
    }
    return QImage();
}

} // namespace

class StartupTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        if (geteuid() != 0)
            QSKIP("needs root: the updater's fixed /home/quarn is mounted in a private mount namespace");
        if (QStandardPaths::findExecutable("unshare").isEmpty())
            QSKIP("needs unshare to make private mount and PID namespaces");
        QProcess probe;
        QTemporaryDir home;
        probe.start(RUN_IN_PRIVATE_HOME, {home.path(), "true"});
        if (!probe.waitForFinished(10000) || probe.exitStatus() != QProcess::NormalExit || probe.exitCode() != 0)
            QSKIP(qPrintable("cannot make private namespaces here: " + probe.readAllStandardError()));
    }

    void handsItsChildrenTheDeviceEnvironment_data()
    {
        QTest::addColumn<QString>("disableXauthority");
        QTest::addColumn<QString>("inheritedXauthority");
        QTest::addColumn<QString>("expectedXauthority");
        QTest::newRow("DISABLE_XAUTHORITY unset") << unset << "/tmp/inherited" << "/home/x_user/.Xauthority";
        QTest::newRow("DISABLE_XAUTHORITY empty") << "" << "/tmp/inherited" << "/home/x_user/.Xauthority";
        QTest::newRow("DISABLE_XAUTHORITY 1") << "1" << "/tmp/inherited" << "/tmp/inherited";
        QTest::newRow("DISABLE_XAUTHORITY 0") << "0" << "/tmp/inherited" << "/tmp/inherited";
        QTest::newRow("DISABLE_XAUTHORITY 1, none inherited") << "1" << unset << unset;
    }

    void handsItsChildrenTheDeviceEnvironment()
    {
        QFETCH(QString, disableXauthority);
        QFETCH(QString, inheritedXauthority);
        QFETCH(QString, expectedXauthority);
        const QStringList device{"QT_IM_MODULE=qtvirtualkeyboard", "QT_VIRTUALKEYBOARD_STYLE=quarn",
                                 "QT_VIRTUALKEYBOARD_LAYOUT_PATH=qrc:/QtQuick/VirtualKeyboard/content/layouts",
                                 "DISPLAY=:0.0", "XDG_SESSION_TYPE=x11",
                                 "QML2_IMPORT_PATH=/home/quarn/usr/lib/qt5/qml/",
                                 "QT_PLUGIN_PATH=/home/quarn/usr/lib/qt5/plugins"};
        UpdaterRun run;
        // Whatever the service manager hands over is replaced.
        for (const QString &variable : device)
            run.environment.insert(variable.section('=', 0, 0), "inherited");
        for (const auto &[name, value] : QList<std::pair<QString, QString>>{{"DISABLE_XAUTHORITY", disableXauthority},
                                                                            {"XAUTHORITY", inheritedXauthority}})
            value == unset ? run.environment.remove(name) : run.environment.insert(name, value);
        run.instrument.recordEnvironment();
        run.start();
        // The first command of the check has written its environment once the second one runs.
        QTRY_VERIFY_WITH_TIMEOUT(
            [&] { auto calls = run.instrument.journal(); return std::count(calls.begin(), calls.end(), "apt update"); }(),
            30000);
        QFile recorded(QString::fromStdString(run.instrument.scenarioDir()) + "/env.systemctl");
        QVERIFY(recorded.open(QIODevice::ReadOnly));
        const QStringList seen = QString::fromUtf8(recorded.readAll()).split('\n');
        for (const QString &variable : device)
            QVERIFY2(seen.contains(variable), qPrintable(variable));
        QCOMPARE(seen.filter(QRegularExpression("^XAUTHORITY=")),
                 expectedXauthority == unset ? QStringList() : QStringList{"XAUTHORITY=" + expectedXauthority});
    }

    // Fonts are registered, each with its log line in directory order, before the
    // scene loads; a scene that cannot load then ends the process with -1.
    void logsItsFontsThenEndsWith255WhenTheSceneCannotLoad()
    {
        const QString validFont = "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf";
        UpdaterRun run;
        run.write("fonts/notes.txt", "not a font\n");
        QFile::copy(validFont, run.home.filePath("fonts/DejaVuSans.ttf"));
        // A module of the device's own QML directory that cannot load: the scene
        // imports it, so the scene cannot load either.
        run.write("usr/lib/qt5/qml/QtQuick/Layouts/qmldir", "module QtQuick.Layouts\nplugin qquicklayoutsplugin_missing\n");
        run.start();
        QVERIFY(run.process.waitForFinished(60000));
        QCOMPARE(run.process.exitStatus(), QProcess::NormalExit);
        QCOMPARE(run.process.exitCode(), 255);
        const QString output = QString::fromUtf8(run.process.readAllStandardError());
        QVERIFY(output.contains("QtQuick.Layouts"));
        if (!QFile::exists(validFont))
            QSKIP("needs the DejaVu fonts (Debian package fonts-dejavu-core) for a valid font");
        QStringList expected{"QuarnUpdater version: 1.0.0"};
        for (const auto &entry : std::filesystem::directory_iterator(run.home.filePath("fonts").toStdString())) {
            const QString name = QString::fromStdString(entry.path().filename().string());
            expected << QString(name.endsWith(".ttf") ? "Added font \"/home/quarn/fonts/%1\""
                                                      : "Failed to add font: \"/home/quarn/fonts/%1\"").arg(name);
        }
        QCOMPARE(output.split('\n').filter(QRegularExpression("^(QuarnUpdater version:|Added font|Failed to add font:)")),
                 expected);
    }

    // German differs from English; "DE" shows German, "xx" and a missing file show English.
    void showsTheLanguageOfTheSettingsFile()
    {
        const QImage english = settledScreen("en"), german = settledScreen("de");
        QVERIFY(!english.isNull() && !german.isNull());
        QVERIFY(german != english);
        QVERIFY(settledScreen("DE") == german);
        QVERIFY(settledScreen("xx") == english);
        QVERIFY(settledScreen(unset) == english);
    }
};

QTEST_GUILESS_MAIN(StartupTest)
#include "tst_startup.moc"
