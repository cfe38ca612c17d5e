#include <QQmlContext>
#include <QQmlEngine>
#include <QtQuickTest>

#include "FakeUpdateManager.h"
#include "Translator.h"

// Every test file gets its own engine with a fresh scripted updateManager and
// the application's translator, loaded with the application's catalogues.
class Setup : public QObject
{
    Q_OBJECT

public slots:
    void qmlEngineAvailable(QQmlEngine *engine)
    {
        static const bool cataloguesLoaded = [] {
            Translator::instance()->loadTranslations(QStringLiteral(":/languages"));
            return true;
        }();
        Q_UNUSED(cataloguesLoaded)

        engine->rootContext()->setContextProperty(QStringLiteral("updateManager"),
                                                  new FakeUpdateManager(engine));
        engine->rootContext()->setContextProperty(QStringLiteral("translator"),
                                                  Translator::instance());
    }
};

QUICK_TEST_MAIN_WITH_SETUP(qml, Setup)

#include "tst_qml.moc"
