#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QLocale>
#include <QTranslator>

namespace {

const char translationBaseName[] = "libkvt-common";
const char translationSeparator[] = "_";
const char systemTranslationsDir[] = "/usr/share/brel/translations";

// Installs the translator of the library's messages. The system directory
// comes first; an install under another prefix and the build tree are
// consulted only when it has no file for the locale. A missing translation is
// not an error: the messages then stay in English.
void installLibraryTranslator()
{
    const QLocale locale = QLocale::system();
    const QStringList dirs = {QString::fromLatin1(systemTranslationsDir),
                              QString::fromLatin1(KVT_TRANSLATIONS_INSTALL_DIR),
                              QString::fromLatin1(KVT_TRANSLATIONS_BUILD_DIR)};

    auto *translator = new QTranslator(QCoreApplication::instance());
    for (const QString &dir : dirs) {
        if (translator->load(locale, QLatin1String(translationBaseName),
                             QLatin1String(translationSeparator), dir)) {
            QCoreApplication::installTranslator(translator);
            return;
        }
    }
    delete translator;
}

} // namespace

Q_COREAPP_STARTUP_FUNCTION(installLibraryTranslator)
