#include "Translator.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QQmlEngine>
#include <QTranslator>

Translator::Translator()
    : QObject(nullptr)
    , mQmlEngine(nullptr)
{
}

Translator *Translator::instance()
{
    static Translator *_instance = new Translator();
    return _instance;
}

void Translator::loadTranslations(const QString &path)
{
    const QFileInfoList catalogues =
        QDir(path).entryInfoList({QStringLiteral("*.qm")}, QDir::Files | QDir::Readable, QDir::Name);
    for (const QFileInfo &catalogue : catalogues) {
        auto *translator = new QTranslator(this);
        // A catalogue that does not load is simply not offered as a language.
        if (!translator->load(catalogue.absoluteFilePath()))
            continue;
        mTranslators.insert(catalogue.baseName(), translator);
    }
}

QStringList Translator::availableLanguages()
{
    QStringList languages;
    for (auto it = mTranslators.cbegin(); it != mTranslators.cend(); ++it)
        languages.append(it.key());
    return languages;
}

void Translator::setQmlEngine(QQmlEngine *engine)
{
    mQmlEngine = engine;
}

void Translator::setLanguage(QString language)
{
    static QTranslator *current = nullptr;

    language = language.toLower();
    if (!mTranslators.contains(language))
        language = QStringLiteral("en");

    if (current)
        QCoreApplication::removeTranslator(current);
    current = mTranslators.value(language, nullptr);
    if (!current)
        return;

    QCoreApplication::installTranslator(current);
    emit languageChanged();
    if (mQmlEngine)
        mQmlEngine->retranslate();
}
