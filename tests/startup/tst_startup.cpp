#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QImage>
#include <QProcess>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QtTest>

#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <map>

#include "FakeInstrument.h"

namespace {

const QString unset = QStringLiteral("<unset>");

void writeFile(const QString &path, const QByteArray &content)
{
    QDir().mkpath(QFileInfo(path).path());
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(content);
}

// One run of the real updater: a directory that becomes /home/quarn, a working
// directory, the fake instrument first on PATH, and the process, killed by its
// id when the run ends.
class UpdaterRun
{
public:
    // Taken after the fake instrument has put itself first on PATH.
    UpdaterRun() : mEnvironment(QProcessEnvironment::systemEnvironment()) {}

    ~UpdaterRun()
    {
        if (mProcess.state() != QProcess::NotRunning) {
            mProcess.kill();
            mProcess.waitForFinished(10000);
        }
    }

    QString homePath(const QString &relative) const { return mHome.filePath(relative); }
    QString workPath() const { return mWork.path(); }
    FakeInstrument &instrument() { return mInstrument; }
    QProcess &process() { return mProcess; }

    void setVariable(const QString &name, const QString &value)
    {
        if (value == unset)
            mEnvironment.remove(name);
        else
            mEnvironment.insert(name, value);
    }

    // The test machine has no display and no GPU: the scene is drawn in
    // software, on the platform the caller chose.
    void start(const QString &platform = QStringLiteral("offscreen"))
    {
        setVariable("QT_QPA_PLATFORM", platform);
        setVariable("QT_QUICK_BACKEND", "software");
        setVariable("QT_LOGGING_RULES", "default.debug=true;qt.qml.connections.warning=false");
        mProcess.setProcessEnvironment(mEnvironment);
        mProcess.setWorkingDirectory(mWork.path());
        mProcess.start(RUN_IN_PRIVATE_HOME, {mHome.path(), UPDATER_EXECUTABLE});
        QVERIFY(mProcess.waitForStarted());
    }

    bool journalHas(const std::string &call) const
    {
        const auto journal = mInstrument.journal();
        return std::find(journal.begin(), journal.end(), call) != journal.end();
    }

private:
    QTemporaryDir mHome;
    QTemporaryDir mWork;
    FakeInstrument mInstrument;
    QProcessEnvironment mEnvironment;
    QProcess mProcess;
};

template <typename Condition>
bool waitFor(Condition condition, int timeoutMs)
{
    QElapsedTimer waiting;
    waiting.start();
    while (!condition()) {
        if (waiting.elapsed() > timeoutMs)
            return false;
        QTest::qWait(100);
    }
    return true;
}

QMap<QString, QString> recordedEnvironment(const QString &path)
{
    QFile file(path);
    file.open(QIODevice::ReadOnly);
    QMap<QString, QString> variables;
    for (const QByteArray &line : file.readAll().split('\n')) {
        const int equals = line.indexOf('=');
        if (equals > 0)
            variables.insert(QString::fromUtf8(line.left(equals)), QString::fromUtf8(line.mid(equals + 1)));
    }
    return variables;
}

QStringList linesStartingWith(const QByteArray &output, const QStringList &prefixes)
{
    QStringList lines;
    for (const QByteArray &line : output.split('\n')) {
        const QString text = QString::fromUtf8(line);
        if (std::any_of(prefixes.begin(), prefixes.end(), [&](const QString &p) { return text.startsWith(p); }))
            lines.append(text);
    }
    return lines;
}

} // namespace

class StartupTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void handsItsChildrenTheDeviceEnvironment_data();
    void handsItsChildrenTheDeviceEnvironment();
    void endsWith255WhenTheSceneCannotLoad();
    void registersEveryFontFileInDirectoryOrder();
    void showsTheLanguageOfTheSettingsFile_data();
    void showsTheLanguageOfTheSettingsFile();
    void germanAndEnglishScreensDiffer();

private:
    QImage settledScreen(const QString &storedLanguage);

    std::map<QString, QImage> mScreens;
};

void StartupTest::initTestCase()
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

void StartupTest::handsItsChildrenTheDeviceEnvironment_data()
{
    QTest::addColumn<QString>("disableXauthority");
    QTest::addColumn<QString>("inheritedXauthority");
    QTest::addColumn<QString>("expectedXauthority");

    const QString device = "/home/x_user/.Xauthority";
    QTest::newRow("DISABLE_XAUTHORITY unset") << unset << "/tmp/inherited" << device;
    QTest::newRow("DISABLE_XAUTHORITY empty") << "" << "/tmp/inherited" << device;
    QTest::newRow("DISABLE_XAUTHORITY 1") << "1" << "/tmp/inherited" << "/tmp/inherited";
    QTest::newRow("DISABLE_XAUTHORITY 0") << "0" << "/tmp/inherited" << "/tmp/inherited";
    QTest::newRow("DISABLE_XAUTHORITY 1, none inherited") << "1" << unset << unset;
}

void StartupTest::handsItsChildrenTheDeviceEnvironment()
{
    QFETCH(QString, disableXauthority);
    QFETCH(QString, inheritedXauthority);
    QFETCH(QString, expectedXauthority);

    UpdaterRun run;
    run.instrument().recordEnvironment();
    run.setVariable("DISABLE_XAUTHORITY", disableXauthority);
    run.setVariable("XAUTHORITY", inheritedXauthority);
    // Whatever the service manager hands over is replaced.
    const QMap<QString, QString> device{
        {"QT_IM_MODULE", "qtvirtualkeyboard"},
        {"QT_VIRTUALKEYBOARD_STYLE", "quarn"},
        {"QT_VIRTUALKEYBOARD_LAYOUT_PATH", "qrc:/QtQuick/VirtualKeyboard/content/layouts"},
        {"DISPLAY", ":0.0"},
        {"XDG_SESSION_TYPE", "x11"},
        {"QML2_IMPORT_PATH", "/home/quarn/usr/lib/qt5/qml/"},
        {"QT_PLUGIN_PATH", "/home/quarn/usr/lib/qt5/plugins"},
    };
    for (auto it = device.cbegin(); it != device.cend(); ++it)
        run.setVariable(it.key(), "inherited");
    run.start();

    // The first command of the check has written its environment completely
    // once the second one runs.
    QTRY_VERIFY_WITH_TIMEOUT(run.journalHas("apt update"), 30000);
    const auto seen = recordedEnvironment(QString::fromStdString(run.instrument().scenarioDir()) + "/env.systemctl");
    for (auto it = device.cbegin(); it != device.cend(); ++it)
        QCOMPARE(seen.value(it.key(), unset), it.value());
    QCOMPARE(seen.value("XAUTHORITY", unset), expectedXauthority);
}

void StartupTest::endsWith255WhenTheSceneCannotLoad()
{
    UpdaterRun run;
    // A module of the device's own QML directory that cannot load: the scene
    // imports it, so the scene cannot load either.
    writeFile(run.homePath("usr/lib/qt5/qml/QtQuick/Layouts/qmldir"),
              "module QtQuick.Layouts\nplugin qquicklayoutsplugin_missing\n");
    run.start();

    QVERIFY(run.process().waitForFinished(60000));
    QCOMPARE(run.process().exitStatus(), QProcess::NormalExit);
    QCOMPARE(run.process().exitCode(), 255);
    QVERIFY(run.process().readAllStandardError().contains("QtQuick.Layouts"));
}

void StartupTest::registersEveryFontFileInDirectoryOrder()
{
    const QString validFont = "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf";
    if (!QFile::exists(validFont))
        QSKIP("needs the DejaVu fonts (Debian package fonts-dejavu-core)");

    UpdaterRun run;
    QVERIFY(QDir().mkpath(run.homePath("fonts")));
    QVERIFY(QFile::copy(validFont, run.homePath("fonts/DejaVuSans.ttf")));
    writeFile(run.homePath("fonts/notes.txt"), "not a font\n");
    run.start();
    QTRY_VERIFY_WITH_TIMEOUT(run.journalHas("systemctl stop druv"), 30000);
    run.process().kill();
    run.process().waitForFinished(10000);

    QStringList expected{"QuarnUpdater version: 1.0.0"};
    for (const auto &entry : std::filesystem::directory_iterator(run.homePath("fonts").toStdString())) {
        const QString name = QString::fromStdString(entry.path().filename().string());
        expected.append(name.endsWith(".ttf") ? QString("Added font \"/home/quarn/fonts/%1\"").arg(name)
                                              : QString("Failed to add font: \"/home/quarn/fonts/%1\"").arg(name));
    }
    const QStringList logged = linesStartingWith(run.process().readAllStandardError(),
                                                 {"QuarnUpdater version:", "Added font", "Failed to add font:"});
    QCOMPARE(logged, expected);
}

// The language shows only on the screen. The minimal platform writes every
// repaint of the window to the working directory. While a page shows, its dots
// change the picture every second; once the check has failed, the warning box
// covers the page, and a picture that stays the same across a tick of the dots
// is the box, complete with its icon.
QImage StartupTest::settledScreen(const QString &storedLanguage)
{
    if (mScreens.count(storedLanguage))
        return mScreens.at(storedLanguage);

    UpdaterRun run;
    if (storedLanguage != unset)
        writeFile(run.homePath("language.ini"), "[General]\nQuarnLanguage=" + storedLanguage.toUtf8() + "\n");
    run.setVariable("QT_DEBUG_BACKINGSTORE", "1");
    run.start("minimal:enable_fonts");

    QDir frames(run.workPath(), "output*.png", QDir::Name, QDir::Files);
    QImage screen;
    waitFor(
        [&] {
            frames.refresh();
            const QFileInfoList names = frames.entryInfoList();
            // The newest file may still be being written; the two before it are whole.
            if (names.count() < 3)
                return false;
            const QFileInfo &last = names.at(names.count() - 2);
            const QFileInfo &previous = names.at(names.count() - 3);
            const QImage picture(last.filePath());
            if (previous.lastModified().msecsTo(last.lastModified()) < 500 || picture != QImage(previous.filePath()))
                return false;
            screen = picture;
            return true;
        },
        60000);
    mScreens[storedLanguage] = screen;
    return screen;
}

void StartupTest::showsTheLanguageOfTheSettingsFile_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("sameAs");

    QTest::newRow("DE shows German") << "DE" << "de";
    QTest::newRow("xx shows English") << "xx" << "en";
    QTest::newRow("no settings file shows English") << unset << "en";
}

void StartupTest::showsTheLanguageOfTheSettingsFile()
{
    QFETCH(QString, stored);
    QFETCH(QString, sameAs);

    const QImage screen = settledScreen(stored);
    const QImage reference = settledScreen(sameAs);
    QVERIFY(!screen.isNull());
    QVERIFY(!reference.isNull());
    QVERIFY(screen == reference);
}

void StartupTest::germanAndEnglishScreensDiffer()
{
    const QImage german = settledScreen("de");
    const QImage english = settledScreen("en");
    QVERIFY(!german.isNull());
    QVERIFY(!english.isNull());
    QVERIFY(german != english);
}

QTEST_GUILESS_MAIN(StartupTest)
#include "tst_startup.moc"
