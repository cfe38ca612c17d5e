#include <QSignalSpy>
#include <QtTest>

#include "Translator.h"

namespace {

QStringList languagesFrom(const QString &path)
{
    Translator translator;
    translator.loadTranslations(path);
    QStringList languages = translator.availableLanguages();
    languages.sort();
    return languages;
}

} // namespace

class TranslatorTest : public QObject
{
    Q_OBJECT

    // A catalogue directory as the instrument might hold it: the probe catalogues,
    // an FR.qm that is really the German one, a damaged catalogue and a text file.
    QTemporaryDir mCatalogues;

private slots:
    void initTestCase()
    {
        for (const QString language : {"de", "en", "fr"})
            QVERIFY(QFile::copy(PROBE_CATALOGUE_DIR "/" + language + ".qm", mCatalogues.filePath(language + ".qm")));
        QVERIFY(QFile::copy(PROBE_CATALOGUE_DIR "/de.qm", mCatalogues.filePath("FR.qm")));
        for (const char *name : {"broken.qm", "notes.txt"}) {
            QFile file(mCatalogues.filePath(name));
            QVERIFY(file.open(QIODevice::WriteOnly) && file.write("not a catalogue\n") > 0);
        }
    }

    void keysLoadableCataloguesByTheirBaseName()
    {
        QCOMPARE(languagesFrom(":/languages"), (QStringList{"de", "en", "es", "fr", "it", "pt", "ru", "zh"}));
        QCOMPARE(languagesFrom(mCatalogues.path()), (QStringList{"FR", "de", "en", "fr"}));
    }

    void installsTheRequestedLanguageOrEnglish_data()
    {
        QTest::addColumn<QStringList>("requests");
        QTest::addColumn<QString>("installed");
        QTest::addColumn<bool>("emptyTable");
        QTest::newRow("upper-case code") << QStringList{"DE"} << "de" << false;
        QTest::newRow("unknown code") << QStringList{"xx"} << "en" << false;
        QTest::newRow("empty code") << QStringList{""} << "en" << false;
        QTest::newRow("same language twice") << QStringList{"en", "en"} << "en" << false;
        QTest::newRow("switch back and forth") << QStringList{"fr", "de", "fr"} << "fr" << false;
        // Lower-casing the request means the FR catalogue can never be chosen.
        QTest::newRow("FR beside fr") << QStringList{"FR"} << "fr" << false;
        // An empty table takes the installed French catalogue away and announces nothing.
        QTest::newRow("empty table") << QStringList{"de"} << "language" << true;
    }

    void installsTheRequestedLanguageOrEnglish()
    {
        QFETCH(QStringList, requests);
        QFETCH(QString, installed);
        QFETCH(bool, emptyTable);
        Translator loaded, empty;
        loaded.loadTranslations(mCatalogues.path());
        if (emptyTable)
            loaded.setLanguage("fr");
        Translator &translator = emptyTable ? empty : loaded;
        QSignalSpy languageChanged(&translator, &Translator::languageChanged);
        for (const QString &request : requests)
            translator.setLanguage(request);
        // Each probe catalogue answers with its own language code, and none with the source text.
        QCOMPARE(QCoreApplication::translate("probe", "language"), installed);
        QCOMPARE(languageChanged.count(), emptyTable ? 0 : requests.size());
    }
};

QTEST_GUILESS_MAIN(TranslatorTest)
#include "tst_translator.moc"
