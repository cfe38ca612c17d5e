#include <QCoreApplication>
#include <QFile>
#include <QQmlComponent>
#include <QQmlEngine>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <QtTest>

#include <memory>

#include "Translator.h"

namespace {

// Each probe catalogue translates this message into its own language code;
// with no catalogue installed the source text comes back.
QString installedProbe()
{
    return QCoreApplication::translate("probe", "language");
}

QStringList sorted(QStringList list)
{
    list.sort();
    return list;
}

// A catalogue directory as the instrument might hold it: the probe catalogues,
// an FR.qm that is really the German one, a damaged catalogue and a text file.
std::unique_ptr<QTemporaryDir> makeCatalogueDir()
{
    auto dir = std::make_unique<QTemporaryDir>();
    const QString probes = QStringLiteral(PROBE_CATALOGUE_DIR "/");
    for (const char *language : {"de", "en", "fr"})
        QFile::copy(probes + language + ".qm", dir->filePath(QString(language) + ".qm"));
    QFile::copy(probes + "de.qm", dir->filePath("FR.qm"));
    for (const char *name : {"broken.qm", "notes.txt"}) {
        QFile file(dir->filePath(name));
        file.open(QIODevice::WriteOnly);
        file.write("not a catalogue\n");
    }
    return dir;
}

} // namespace

class TranslatorTest : public QObject
{
    Q_OBJECT

private slots:
    void loadsTheEightCataloguesOfTheApplication();
    void keysLoadableCataloguesByTheirBaseName();
    void installsTheRequestedLanguageOrEnglish_data();
    void installsTheRequestedLanguageOrEnglish();
    void anEmptyTableRemovesTheInstalledCatalogue();
    void retranslatesTheQmlEngineAfterAnnouncingTheSwitch();
};

void TranslatorTest::loadsTheEightCataloguesOfTheApplication()
{
    Translator translator;
    translator.loadTranslations(":/languages");
    QCOMPARE(sorted(translator.availableLanguages()),
             (QStringList{"de", "en", "es", "fr", "it", "pt", "ru", "zh"}));
}

void TranslatorTest::keysLoadableCataloguesByTheirBaseName()
{
    const auto dir = makeCatalogueDir();
    Translator translator;
    translator.loadTranslations(dir->path());
    QCOMPARE(sorted(translator.availableLanguages()), (QStringList{"FR", "de", "en", "fr"}));
}

void TranslatorTest::installsTheRequestedLanguageOrEnglish_data()
{
    QTest::addColumn<QStringList>("requests");
    QTest::addColumn<QString>("installed");
    QTest::addColumn<int>("announcements");

    QTest::newRow("upper-case code") << QStringList{"DE"} << "de" << 1;
    QTest::newRow("unknown code") << QStringList{"xx"} << "en" << 1;
    QTest::newRow("empty code") << QStringList{""} << "en" << 1;
    QTest::newRow("same language twice") << QStringList{"en", "en"} << "en" << 2;
    QTest::newRow("switch back and forth") << QStringList{"fr", "de", "fr"} << "fr" << 3;
    // Lower-casing the request means the FR catalogue can never be chosen.
    QTest::newRow("FR beside fr") << QStringList{"FR"} << "fr" << 1;
}

void TranslatorTest::installsTheRequestedLanguageOrEnglish()
{
    QFETCH(QStringList, requests);
    QFETCH(QString, installed);
    QFETCH(int, announcements);

    const auto dir = makeCatalogueDir();
    Translator translator;
    translator.loadTranslations(dir->path());
    QSignalSpy languageChanged(&translator, &Translator::languageChanged);

    for (const QString &request : requests)
        translator.setLanguage(request);

    QCOMPARE(installedProbe(), installed);
    QCOMPARE(languageChanged.count(), announcements);
}

void TranslatorTest::anEmptyTableRemovesTheInstalledCatalogue()
{
    const auto dir = makeCatalogueDir();
    Translator loaded;
    loaded.loadTranslations(dir->path());
    loaded.setLanguage("fr");
    QCOMPARE(installedProbe(), QString("fr"));

    Translator empty;
    QSignalSpy languageChanged(&empty, &Translator::languageChanged);
    empty.setLanguage("de");

    QCOMPARE(installedProbe(), QString("language"));
    QCOMPARE(languageChanged.count(), 0);
}

void TranslatorTest::retranslatesTheQmlEngineAfterAnnouncingTheSwitch()
{
    const auto dir = makeCatalogueDir();
    Translator translator;
    translator.loadTranslations(dir->path());
    translator.setLanguage("en");

    QQmlEngine engine;
    QQmlComponent component(&engine);
    component.setData("import QtQml 2.0\nQtObject { property string text: qsTranslate(\"probe\", \"language\") }",
                      QUrl());
    const std::unique_ptr<QObject> scene(component.create());
    QVERIFY2(scene, qPrintable(component.errorString()));
    translator.setQmlEngine(&engine);

    QString textWhenAnnounced;
    connect(&translator, &Translator::languageChanged, this,
            [&] { textWhenAnnounced = scene->property("text").toString(); });
    translator.setLanguage("de");

    QCOMPARE(textWhenAnnounced, QString("en"));
    QCOMPARE(scene->property("text").toString(), QString("de"));
}

QTEST_GUILESS_MAIN(TranslatorTest)
#include "tst_translator.moc"
