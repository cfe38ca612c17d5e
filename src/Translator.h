#pragma once

#include <QHash>
#include <QObject>
#include <QString>
#include <QStringList>

class QQmlEngine;
class QTranslator;

// The user-interface languages: every compiled catalogue of a directory, keyed
// by its file's base name, and at most one of them installed at a time, with
// English as the fallback.
class Translator : public QObject
{
    Q_OBJECT

public:
    Translator();

    static Translator *instance();

    void loadTranslations(const QString &path);
    QStringList availableLanguages();
    void setQmlEngine(QQmlEngine *engine);

    Q_INVOKABLE void setLanguage(QString language);

signals:
    void languageChanged() const;

private:
    QHash<QString, QTranslator *> mTranslators;
    QQmlEngine *mQmlEngine;
};
