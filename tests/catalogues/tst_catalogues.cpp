// The resources compiled into the updater: every text the user reads, to the character, the icons and the style.
#include <QImageReader>
#include <QXmlStreamReader>
#include <QtTest>

namespace {

// The messages of the scene, in the order of the translation rows below.
const QStringList sources = {
    "KAVOR Networks Updater", "Checking software updates...\nPlease wait.\n",
    "Installing software updates...\nPlease wait.\n", "Closing updater application...\nPlease wait.\n", "YES", "NO",
    "CLOSE", "No updates found.", "Software update successfully installed.",
    "Checking for updates failed. Please make sure USB drive has been prepared properly.",
    "Installing of update failed. Please try again later."};

const QMap<QString, QStringList> translations = {
    {"de", {"KAVOR Networks Updater", "Prüfung auf Software-Updates...\nBitte warten.\n", "Software-Updates werden installiert...\nBitte warten.\n", "Der Updater wird geschlossen...\nBitte warten.\n", "JA", "NEIN", "SCHLIESSEN", "Keine Updates gefunden.", "Software-Update erfolgreich installiert.", "Fehler bei der Prüfung auf Updates. Bitte vergewissern Sie sich, dass das USB-Laufwerk korrekt vorbereitet wurde.", "Fehler bei der Installation des Updates. Bitte versuchen Sie es später erneut."}},
    // The closing text alone has no final line break: its dots follow "espere." on the same line.
    {"es", {"Actualizador de KAVOR Networks", "Comprobando actualizaciones de software...\nPor favor, espere.\n", "Instalando actualizaciones de software...\nPor favor, espere.\n", "Cerrando la aplicación de actualización...\nPor favor, espere.", "SÍ", "NO", "CERRAR", "No se han encontrado actualizaciones.", "La actualización del software se ha instalado correctamente.", "La búsqueda de actualizaciones ha fallado. Asegúrese de que la unidad USB ha sido preparada correctamente.", "Error en la instalación de la actualización. Por favor, inténtelo de nuevo más tarde."}},
    // A single ellipsis character in the checking text, three full stops elsewhere.
    {"fr", {"Mise à jour KAVOR Networks", "Recherche de mises à jour logicielles\u2026\nVeuillez patienter.\n", "Installation des mises à jour logicielles...\nVeuillez patienter.\n", "Fermeture de l'application des mises à jour...\nVeuillez patienter.\n", "OUI", "NON", "FERMER", "Pas de mises à jour disponibles.", "La mise à jour logicielle a été installée avec succès.", "La recherche des mises à jour a échoué. Veuillez vérifier que la clé USB a été correctement configurée.", "L'installation de la mise à jour a échoué. Veuillez réessayer ultérieurement."}},
    // The failure text has a typographic apostrophe.
    {"it", {"Utility di aggiornamento KAVOR Networks", "Verifica disponibilità aggiornamenti software in corso...\nAttendere.\n", "Installazione aggiornamenti software in corso...\nAttendere.\n", "Chiusura utility di aggiornamento in corso...\nAttendere.\n", "SÌ", "NO", "CHIUDI", "Nessun aggiornamento disponibile trovato.", "Aggiornamento software eseguito correttamente.", "Verifica disponibilità aggiornamenti non riuscita. Assicurarsi che l\u2019unità USB sia stata preparata correttamente.", "Installazione aggiornamento non riuscita. Riprovare in seguito."}},
    // "No updates found." keeps its trailing blank.
    {"pt", {"Atualizadores das Redes KAVOR", "A procurar atualizações de software...\nAguarde.\n", "A instalar as atualizações de software...\nAguarde.\n", "A fechar a aplicação do atualizador...\nAguarde.\n", "SIM", "NÃO", "FECHAR", "Nenhuma atualização encontrada. ", "Atualização do software instalada com sucesso.", "A verificação de atualizações falhou. Verifique se a porta USB está adequadamente preparada.", "A instalação da atualização falhou. Tente novamente mais tarde."}},
    {"ru", {"Программа установки обновлений KAVOR Networks", "Проверка обновлений ПО...\nПожалуйста, подождите.\n", "Установка обновлений ПО...\nПожалуйста, подождите.\n", "Завершение работы программы установки обновлений...\nПожалуйста, подождите.\n", "ДА", "НЕТ", "ЗАКРЫТЬ", "Обновления не найдены.", "Обновление программного обеспечения успешно установлено.", "Не удалось проверить наличие обновлений. Пожалуйста, убедитесь, что USB-накопитель подготовлен надлежащим образом.", "Не удалось установить обновление. Пожалуйста, повторите попытку позже."}},
    {"zh", {"KAVOR 网络更新程序", "正在检查软件更新...\n请稍候。\n", "正在安装软件更新...\n请稍候。\n", "正在关闭更新程序应用程序...\n请稍候。\n", "是", "否", "关闭", "未找到更新。", "软件更新已成功安装。", "检查更新失败。请确保已正确准备 USB 驱动器。", "安装更新失败。请稍后再试。"}},
};

// Shown as written whatever the language: the list of updates is put into it.
const char updateQuestion[] = "Software update has been found.\n\n%1\nDo you want to update?";

} // namespace

class ResourcesTest : public QObject
{
    Q_OBJECT

private slots:
    void showsEveryMessageInTheInstalledLanguage_data()
    {
        QTest::addColumn<QString>("language");
        for (const char *language : {"de", "en", "es", "fr", "it", "pt", "ru", "zh"})
            QTest::newRow(language) << language;
    }

    void showsEveryMessageInTheInstalledLanguage()
    {
        QFETCH(QString, language);
        // Uncompressed, a catalogue is read in place instead of unpacked.
        QCOMPARE(QResource(":/languages/" + language + ".qm").compressionAlgorithm(), QResource::NoCompression);
        QTranslator catalogue;
        QVERIFY(catalogue.load(":/languages/" + language + ".qm"));
        QVERIFY(QCoreApplication::installTranslator(&catalogue));
        // English holds "CLOSE" only; every other text falls through to its source.
        const QStringList shown = translations.value(language, sources);
        for (int i = 0; i < sources.size(); ++i) {
            QCOMPARE(QCoreApplication::translate("main", qPrintable(sources[i])), shown[i]);
            if (language == "en")
                QCOMPARE(catalogue.translate("main", qPrintable(sources[i])), sources[i] == "CLOSE" ? sources[i] : QString());
        }
        QCOMPARE(catalogue.translate("main", updateQuestion), QString());
        QCOMPARE(QCoreApplication::translate("main", updateQuestion), QString(updateQuestion));
    }

    // Rendered at the size the message box shows, as the SVG image plug-in does it:
    // one flat colour covering a good part of the square, on transparency.
    void drawsEachIconToItsViewBoxSizeAndColour_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("viewBox");
        QTest::addColumn<QString>("declaredSize");
        QTest::addColumn<QColor>("colour");
        QTest::newRow("information") << ":/information.svg" << "0 0 330 330" << "512px" << QColor("#0061a7");
        QTest::newRow("question") << ":/question.svg" << "0 0 512 512" << "" << QColor("#0061a7");
        QTest::newRow("warning") << ":/warning.svg" << "0 0 512 512" << "512px" << QColor("#ff7043");
    }

    void drawsEachIconToItsViewBoxSizeAndColour()
    {
        QFETCH(QString, path);
        QFETCH(QString, viewBox);
        QFETCH(QString, declaredSize);
        QFETCH(QColor, colour);
        QCOMPARE(QResource(path).compressionAlgorithm(), QResource::NoCompression);
        QFile file(path);
        QVERIFY(file.open(QIODevice::ReadOnly));
        QXmlStreamReader svg(&file);
        QVERIFY(svg.readNextStartElement() && svg.name() == QLatin1String("svg"));
        QStringList attributes;
        for (const char *name : {"version", "viewBox", "width", "height"})
            attributes << svg.attributes().value(name).toString();
        QCOMPARE(attributes, (QStringList{"1.1", viewBox, declaredSize, declaredSize}));

        QImageReader reader(path);
        QCOMPARE(reader.size(), QSize(512, 512));
        reader.setScaledSize(QSize(200, 200));
        const QImage icon = reader.read().convertToFormat(QImage::Format_ARGB32);
        QVERIFY2(!icon.isNull(), qPrintable(reader.errorString()));
        QCOMPARE(icon.pixelColor(0, 0).alpha(), 0);
        int solid = 0;
        for (int pixel = 0; pixel < 200 * 200; ++pixel) {
            const QColor shown = icon.pixelColor(pixel % 200, pixel / 200);
            if (shown.alpha() < 255)
                continue;
            QCOMPARE(shown, colour);
            ++solid;
        }
        QVERIFY2(solid > 4000 && solid < 20000, qPrintable(QString::number(solid) + " solid pixels"));
    }

    // Written on a PC, with CRLF line endings: splitting at CRLF leaves any bare line feed inside a line.
    void styleFileSelectsTheBlueMaterialTheme()
    {
        QFile style(STYLE_FILE);
        QVERIFY(style.open(QIODevice::ReadOnly));
        QCOMPARE(QString::fromUtf8(style.readAll()).split("\r\n"),
                 (QStringList{"[Controls]", "Style=Material", "", "[Material]", "Accent=#17468F",
                              "Background=#FAFAFA", "Primary=#17468F", "Theme=Light", "", "[Universal]",
                              "Accent=#41cd52", "Theme=Light", ""}));
    }
};

QTEST_MAIN(ResourcesTest)
#include "tst_catalogues.moc"
