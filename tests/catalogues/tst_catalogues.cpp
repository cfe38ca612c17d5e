// The translation catalogues compiled into the updater: every text the user reads,
// in every language the instrument offers, to the last character.
#include <QCoreApplication>
#include <QDir>
#include <QResource>
#include <QTranslator>
#include <QtTest>

namespace {

// The messages of the scene, in the order of the translation rows below.
const QStringList sources = {
    QStringLiteral("KAVOR Networks Updater"), QStringLiteral("Checking software updates...\nPlease wait.\n"),
    QStringLiteral("Installing software updates...\nPlease wait.\n"),
    QStringLiteral("Closing updater application...\nPlease wait.\n"),
    QStringLiteral("YES"), QStringLiteral("NO"), QStringLiteral("CLOSE"),
    QStringLiteral("No updates found."), QStringLiteral("Software update successfully installed."),
    QStringLiteral("Checking for updates failed. Please make sure USB drive has been prepared properly."),
    QStringLiteral("Installing of update failed. Please try again later."),
};

const QMap<QString, QStringList> translations = {
    {QStringLiteral("de"), {QStringLiteral("KAVOR Networks Updater"), QStringLiteral("Prüfung auf Software-Updates...\nBitte warten.\n"), QStringLiteral("Software-Updates werden installiert...\nBitte warten.\n"), QStringLiteral("Der Updater wird geschlossen...\nBitte warten.\n"), QStringLiteral("JA"), QStringLiteral("NEIN"), QStringLiteral("SCHLIESSEN"), QStringLiteral("Keine Updates gefunden."), QStringLiteral("Software-Update erfolgreich installiert."), QStringLiteral("Fehler bei der Prüfung auf Updates. Bitte vergewissern Sie sich, dass das USB-Laufwerk korrekt vorbereitet wurde."), QStringLiteral("Fehler bei der Installation des Updates. Bitte versuchen Sie es später erneut.")}},
    // The closing text alone has no final line break: its dots follow "espere." on the same line.
    {QStringLiteral("es"), {QStringLiteral("Actualizador de KAVOR Networks"), QStringLiteral("Comprobando actualizaciones de software...\nPor favor, espere.\n"), QStringLiteral("Instalando actualizaciones de software...\nPor favor, espere.\n"), QStringLiteral("Cerrando la aplicación de actualización...\nPor favor, espere."), QStringLiteral("SÍ"), QStringLiteral("NO"), QStringLiteral("CERRAR"), QStringLiteral("No se han encontrado actualizaciones."), QStringLiteral("La actualización del software se ha instalado correctamente."), QStringLiteral("La búsqueda de actualizaciones ha fallado. Asegúrese de que la unidad USB ha sido preparada correctamente."), QStringLiteral("Error en la instalación de la actualización. Por favor, inténtelo de nuevo más tarde.")}},
    // A single ellipsis character in the checking text, three full stops elsewhere.
    {QStringLiteral("fr"), {QStringLiteral("Mise à jour KAVOR Networks"), QStringLiteral("Recherche de mises à jour logicielles\u2026\nVeuillez patienter.\n"), QStringLiteral("Installation des mises à jour logicielles...\nVeuillez patienter.\n"), QStringLiteral("Fermeture de l'application des mises à jour...\nVeuillez patienter.\n"), QStringLiteral("OUI"), QStringLiteral("NON"), QStringLiteral("FERMER"), QStringLiteral("Pas de mises à jour disponibles."), QStringLiteral("La mise à jour logicielle a été installée avec succès."), QStringLiteral("La recherche des mises à jour a échoué. Veuillez vérifier que la clé USB a été correctement configurée."), QStringLiteral("L'installation de la mise à jour a échoué. Veuillez réessayer ultérieurement.")}},
    // The failure text has a typographic apostrophe.
    {QStringLiteral("it"), {QStringLiteral("Utility di aggiornamento KAVOR Networks"), QStringLiteral("Verifica disponibilità aggiornamenti software in corso...\nAttendere.\n"), QStringLiteral("Installazione aggiornamenti software in corso...\nAttendere.\n"), QStringLiteral("Chiusura utility di aggiornamento in corso...\nAttendere.\n"), QStringLiteral("SÌ"), QStringLiteral("NO"), QStringLiteral("CHIUDI"), QStringLiteral("Nessun aggiornamento disponibile trovato."), QStringLiteral("Aggiornamento software eseguito correttamente."), QStringLiteral("Verifica disponibilità aggiornamenti non riuscita. Assicurarsi che l\u2019unità USB sia stata preparata correttamente."), QStringLiteral("Installazione aggiornamento non riuscita. Riprovare in seguito.")}},
    // "No updates found." keeps its trailing blank.
    {QStringLiteral("pt"), {QStringLiteral("Atualizadores das Redes KAVOR"), QStringLiteral("A procurar atualizações de software...\nAguarde.\n"), QStringLiteral("A instalar as atualizações de software...\nAguarde.\n"), QStringLiteral("A fechar a aplicação do atualizador...\nAguarde.\n"), QStringLiteral("SIM"), QStringLiteral("NÃO"), QStringLiteral("FECHAR"), QStringLiteral("Nenhuma atualização encontrada. "), QStringLiteral("Atualização do software instalada com sucesso."), QStringLiteral("A verificação de atualizações falhou. Verifique se a porta USB está adequadamente preparada."), QStringLiteral("A instalação da atualização falhou. Tente novamente mais tarde.")}},
    {QStringLiteral("ru"), {QStringLiteral("Программа установки обновлений KAVOR Networks"), QStringLiteral("Проверка обновлений ПО...\nПожалуйста, подождите.\n"), QStringLiteral("Установка обновлений ПО...\nПожалуйста, подождите.\n"), QStringLiteral("Завершение работы программы установки обновлений...\nПожалуйста, подождите.\n"), QStringLiteral("ДА"), QStringLiteral("НЕТ"), QStringLiteral("ЗАКРЫТЬ"), QStringLiteral("Обновления не найдены."), QStringLiteral("Обновление программного обеспечения успешно установлено."), QStringLiteral("Не удалось проверить наличие обновлений. Пожалуйста, убедитесь, что USB-накопитель подготовлен надлежащим образом."), QStringLiteral("Не удалось установить обновление. Пожалуйста, повторите попытку позже.")}},
    {QStringLiteral("zh"), {QStringLiteral("KAVOR 网络更新程序"), QStringLiteral("正在检查软件更新...\n请稍候。\n"), QStringLiteral("正在安装软件更新...\n请稍候。\n"), QStringLiteral("正在关闭更新程序应用程序...\n请稍候。\n"), QStringLiteral("是"), QStringLiteral("否"), QStringLiteral("关闭"), QStringLiteral("未找到更新。"), QStringLiteral("软件更新已成功安装。"), QStringLiteral("检查更新失败。请确保已正确准备 USB 驱动器。"), QStringLiteral("安装更新失败。请稍后再试。")}},
};

// Shown as written whatever the language: the list of updates is put into it.
const QString updateQuestion = QStringLiteral("Software update has been found.\n\n%1\nDo you want to update?");

const QStringList languages = {"de", "en", "es", "fr", "it", "pt", "ru", "zh"};

QString cataloguePath(const QString &language)
{
    return QStringLiteral(":/languages/%1.qm").arg(language);
}

QString shownText(const QString &source)
{
    return QCoreApplication::translate("main", source.toUtf8().constData());
}

} // namespace

class CatalogueTest : public QObject
{
    Q_OBJECT

private slots:
    void offersExactlyTheEightLanguages()
    {
        QStringList expected;
        for (const QString &language : languages)
            expected << language + QStringLiteral(".qm");
        QCOMPARE(QDir(QStringLiteral(":/languages")).entryList(QDir::Files, QDir::Name), expected);
    }

    // Uncompressed, the translator reads a catalogue in place instead of unpacking a copy.
    void storesTheCataloguesUncompressed()
    {
        for (const QString &language : languages)
            QCOMPARE(QResource(cataloguePath(language)).compressionAlgorithm(), QResource::NoCompression);
    }

    void showsEveryMessageInTheChosenLanguage_data()
    {
        QTest::addColumn<QString>("language");
        QTest::addColumn<QString>("source");
        QTest::addColumn<QString>("shown");
        for (auto it = translations.cbegin(); it != translations.cend(); ++it) {
            for (int i = 0; i < sources.size(); ++i)
                QTest::addRow("%s: %s", qPrintable(it.key()), qPrintable(sources.at(i))) << it.key() << sources.at(i) << it.value().at(i);
        }
        // English holds "CLOSE" only; every other text falls through to its source.
        for (const QString &source : sources)
            QTest::addRow("en: %s", qPrintable(source)) << QStringLiteral("en") << source << source;
    }

    void showsEveryMessageInTheChosenLanguage()
    {
        QFETCH(QString, language);
        QFETCH(QString, source);
        QFETCH(QString, shown);
        QTranslator catalogue;
        QVERIFY(catalogue.load(cataloguePath(language)));
        QVERIFY(QCoreApplication::installTranslator(&catalogue));
        QCOMPARE(shownText(source), shown);
    }

    void englishCatalogueHoldsOnlyClose()
    {
        QTranslator catalogue;
        QVERIFY(catalogue.load(cataloguePath(QStringLiteral("en"))));
        for (const QString &source : sources) {
            const QString expected = source == QLatin1String("CLOSE") ? source : QString();
            QCOMPARE(catalogue.translate("main", source.toUtf8().constData()), expected);
        }
    }

    // The catalogue's language selects its plural rules; Chinese has none of its own.
    void carriesThePluralRulesOfItsLanguage()
    {
        for (const QString &language : languages) {
            QTranslator catalogue;
            QVERIFY(catalogue.load(cataloguePath(language)));
            QCOMPARE(catalogue.language(), language == QLatin1String("zh") ? QString() : language);
        }
    }

    void asksTheUpdateQuestionInEnglish_data()
    {
        QTest::addColumn<QString>("language");
        for (const QString &language : languages)
            QTest::newRow(qPrintable(language)) << language;
    }

    void asksTheUpdateQuestionInEnglish()
    {
        QFETCH(QString, language);
        QTranslator catalogue;
        QVERIFY(catalogue.load(cataloguePath(language)));
        QVERIFY(QCoreApplication::installTranslator(&catalogue));
        QVERIFY(catalogue.translate("main", updateQuestion.toUtf8().constData()).isEmpty());
        QCOMPARE(shownText(updateQuestion), updateQuestion);
    }
};

QTEST_GUILESS_MAIN(CatalogueTest)
#include "tst_catalogues.moc"
