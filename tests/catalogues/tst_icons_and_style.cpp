// The message box's icons and the Quick Controls style file, as built into the updater.
#include <QColor>
#include <QFile>
#include <QImage>
#include <QImageReader>
#include <QResource>
#include <QXmlStreamReader>
#include <QtTest>

class IconsAndStyleTest : public QObject
{
    Q_OBJECT

private slots:
    void iconIsStoredUncompressedWithItsViewBoxAndSize_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QString>("viewBox");
        QTest::addColumn<QString>("declaredSize");
        QTest::newRow("information") << ":/information.svg" << "0 0 330 330" << "512px";
        QTest::newRow("question") << ":/question.svg" << "0 0 512 512" << "";
        QTest::newRow("warning") << ":/warning.svg" << "0 0 512 512" << "512px";
    }

    void iconIsStoredUncompressedWithItsViewBoxAndSize()
    {
        QFETCH(QString, path);
        QFETCH(QString, viewBox);
        QFETCH(QString, declaredSize);
        QCOMPARE(QResource(path).compressionAlgorithm(), QResource::NoCompression);
        QFile icon(path);
        QVERIFY(icon.open(QIODevice::ReadOnly));
        QXmlStreamReader svg(&icon);
        QVERIFY(svg.readNextStartElement());
        QCOMPARE(svg.name().toString(), QStringLiteral("svg"));
        QCOMPARE(svg.attributes().value("version").toString(), QStringLiteral("1.1"));
        QCOMPARE(svg.attributes().value("viewBox").toString(), viewBox);
        QCOMPARE(svg.attributes().value("width").toString(), declaredSize);
        QCOMPARE(svg.attributes().value("height").toString(), declaredSize);
    }

    void iconIsOneFlatColourOnTransparency_data()
    {
        QTest::addColumn<QString>("path");
        QTest::addColumn<QColor>("colour");
        QTest::newRow("information") << ":/information.svg" << QColor("#0061a7");
        QTest::newRow("question") << ":/question.svg" << QColor("#0061a7");
        QTest::newRow("warning") << ":/warning.svg" << QColor("#ff7043");
    }

    // Rendered at the size the message box shows, as the SVG image plug-in does it.
    void iconIsOneFlatColourOnTransparency()
    {
        QFETCH(QString, path);
        QFETCH(QColor, colour);
        QImageReader reader(path);
        QCOMPARE(reader.size(), QSize(512, 512));
        reader.setScaledSize(QSize(200, 200));
        const QImage icon = reader.read().convertToFormat(QImage::Format_ARGB32);
        QVERIFY2(!icon.isNull(), qPrintable(reader.errorString()));
        QCOMPARE(icon.pixelColor(0, 0).alpha(), 0);
        int solid = 0;
        for (int y = 0; y < icon.height(); ++y) {
            for (int x = 0; x < icon.width(); ++x) {
                if (icon.pixelColor(x, y).alpha() < 255)
                    continue;
                QCOMPARE(icon.pixelColor(x, y), colour);
                ++solid;
            }
        }
        // The figure covers a good part of the square, not a speck and not all of it.
        QVERIFY(solid > icon.width() * icon.height() / 10);
        QVERIFY(solid < icon.width() * icon.height() / 2);
    }

    // Qt Quick Controls reads this file on the instrument exactly as it was written on a PC:
    // with CRLF line endings and a blank line between its sections.
    void styleFileSelectsTheBlueMaterialTheme()
    {
        QFile style(QStringLiteral(STYLE_FILE));
        QVERIFY(style.open(QIODevice::ReadOnly));
        // Splitting at CRLF leaves any bare line feed inside a line, where the comparison finds it.
        const QStringList lines = QString::fromUtf8(style.readAll()).split(QStringLiteral("\r\n"));
        const QStringList expected = {"[Controls]", "Style=Material", "",
                                      "[Material]", "Accent=#17468F", "Background=#FAFAFA", "Primary=#17468F", "Theme=Light", "",
                                      "[Universal]", "Accent=#41cd52", "Theme=Light", ""};
        QCOMPARE(lines, expected);
    }
};

QTEST_MAIN(IconsAndStyleTest)
#include "tst_icons_and_style.moc"
