#include <QDebug>
#include <QDir>
#include <QFileInfo>
#include <QFont>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QQmlApplicationEngine>
#include <QQmlContext>
#include <QQuickStyle>
#include <QSettings>
#include <QUrl>

#include "GuiUpdateManager.h"
#include "Translator.h"

namespace {

// The board's X display, its virtual keyboard and the Qt plug-ins and QML
// modules of the device image. Each value replaces whatever the service
// manager handed us.
void prepareEnvironment()
{
    qputenv("QT_IM_MODULE", "qtvirtualkeyboard");
    qputenv("QT_VIRTUALKEYBOARD_STYLE", "quarn");
    qputenv("QT_VIRTUALKEYBOARD_LAYOUT_PATH", "qrc:/QtQuick/VirtualKeyboard/content/layouts");
    qputenv("DISPLAY", ":0.0");
    // A development machine or a test display may run without an authority
    // file; any non-empty value keeps the inherited XAUTHORITY.
    if (qEnvironmentVariableIsEmpty("DISABLE_XAUTHORITY"))
        qputenv("XAUTHORITY", "/home/x_user/.Xauthority");
    qputenv("XDG_SESSION_TYPE", "x11");
    qputenv("QML2_IMPORT_PATH", "/home/quarn/usr/lib/qt5/qml/");
    qputenv("QT_PLUGIN_PATH", "/home/quarn/usr/lib/qt5/plugins");
}

// A font the database rejects is only reported: the application font falls
// back to whatever family the system can match.
void registerFonts(const QFileInfoList &fontFiles)
{
    for (const QFileInfo &fontFile : fontFiles) {
        if (QFontDatabase::addApplicationFont(fontFile.filePath()) == -1)
            qWarning() << "Failed to add font:" << fontFile.absoluteFilePath();
        else
            qDebug() << "Added font" << fontFile.absoluteFilePath();
    }
}

} // namespace

int main(int argc, char *argv[])
{
    prepareEnvironment();
    QCoreApplication::setApplicationName(QStringLiteral("QuarnUpdater"));
    QCoreApplication::setOrganizationName(QStringLiteral("KAVOR"));
    QCoreApplication::setAttribute(Qt::AA_EnableHighDpiScaling, true);

    QGuiApplication app(argc, argv);

    // The language is chosen once, before any QML exists, so the scene shows
    // its texts in that language from the first frame.
    Translator::instance()->loadTranslations(QStringLiteral(":/languages"));
    QSettings languageSettings(QStringLiteral("/home/quarn/language.ini"), QSettings::IniFormat);
    Translator::instance()->setLanguage(
        languageSettings.value(QStringLiteral("QuarnLanguage"), QStringLiteral("en")).toString());

    qDebug() << "QuarnUpdater version: 1.0.0";
    QQuickStyle::setStyle(QStringLiteral("Material"));

    const QFileInfoList fontFiles =
        QDir(QStringLiteral("/home/quarn/fonts/")).entryInfoList(QDir::Files, QDir::NoSort);
    registerFonts(fontFiles);
    const QFont defaultFont(QStringLiteral("Montserrat"), 12, QFont::Medium, false);
    QGuiApplication::setFont(defaultFont);

    QQmlApplicationEngine engine;
    const QUrl sceneUrl(QStringLiteral("qrc:/main.qml"));
    // Without a scene the instrument would show an empty screen forever;
    // ending the process lets the service manager see the failure.
    QObject::connect(
        &engine, &QQmlApplicationEngine::objectCreated, &app,
        [sceneUrl](QObject *scene, const QUrl &url) {
            if (!scene && url == sceneUrl)
                QCoreApplication::exit(-1);
        },
        Qt::QueuedConnection);
    engine.rootContext()->setContextProperty(QStringLiteral("updateManager"),
                                             GuiUpdateManager::instance());
    engine.load(sceneUrl);

    return app.exec();
}
