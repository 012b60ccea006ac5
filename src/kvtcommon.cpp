// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "kvticons_p.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QHash>
#include <QLocale>
#include <QTranslator>

#include <dlfcn.h>

namespace {

const char translationBaseName[] = "libkvt-common";
const char translationSeparator[] = "_";
const char systemTranslationsDir[] = "/usr/share/brel/translations";
const char bundledIconRoot[] = ":/kvt-common/icons";
const int bundledIconSizes[] = {16, 22, 32};

// The translations folder beside the library as it is loaded: <libdir>/
// KVT_TRANSLATIONS_FROM_LIBDIR, in an installed prefix and in the build tree
// alike. Empty when the library's own file cannot be found.
QString ownTranslationsDir()
{
    Dl_info info;
    if (dladdr(reinterpret_cast<void *>(&ownTranslationsDir), &info) == 0 || !info.dli_fname)
        return QString();
    // Canonical: on a merged-/usr system the library may be reached through
    // /lib, whose ../share is not /usr/share.
    const QString libDir = QFileInfo(QFile::decodeName(info.dli_fname)).canonicalPath();
    if (libDir.isEmpty())
        return QString();
    return QDir::cleanPath(libDir + QLatin1Char('/') + QLatin1String(KVT_TRANSLATIONS_FROM_LIBDIR));
}

// Installs the translator of the library's messages. The folder beside the
// library comes first, so a build tree or an install under another prefix uses
// its own translations; then the system folder. A missing translation is not
// an error: the messages then stay in English.
void installLibraryTranslator()
{
    const QLocale locale = QLocale::system();
    QStringList dirs;
    const QString own = ownTranslationsDir();
    if (!own.isEmpty())
        dirs.append(own);
    const QString system = QString::fromLatin1(systemTranslationsDir);
    if (!dirs.contains(system))
        dirs.append(system);

    auto *translator = new QTranslator(QCoreApplication::instance());
    for (const QString &dir : qAsConst(dirs)) {
        if (translator->load(locale, QLatin1String(translationBaseName),
                             QLatin1String(translationSeparator), dir)) {
            QCoreApplication::installTranslator(translator);
            return;
        }
    }
    delete translator;
}

// Lets theme look-ups by name that the library does not make itself (icons of
// Designer forms, of host applications) fall back on the library's icons.
void addIconFallbackPath()
{
    if (!qobject_cast<QGuiApplication *>(QCoreApplication::instance()))
        return;
    QStringList paths = QIcon::fallbackSearchPaths();
    const QString dir = kvtBundledIconDir();
    if (!paths.contains(dir)) {
        paths.append(dir);
        QIcon::setFallbackSearchPaths(paths);
    }
}

void startLibrary()
{
    installLibraryTranslator();
    addIconFallbackPath();
}

} // namespace

QString kvtBundledIconDir()
{
    return QLatin1String(bundledIconRoot) + QLatin1String("/32");
}

QIcon kvtBundledIcon(const QString &name)
{
    // Icons belong to the interface thread; views ask for them at every paint.
    static QHash<QString, QIcon> cache;
    auto it = cache.constFind(name);
    if (it != cache.constEnd())
        return *it;
    QIcon icon;
    for (int size : bundledIconSizes) {
        const QString file = QStringLiteral("%1/%2/%3.png").arg(QLatin1String(bundledIconRoot)).arg(size).arg(name);
        if (QFile::exists(file))
            icon.addFile(file, QSize(size, size));
    }
    cache.insert(name, icon);
    return icon;
}

QIcon kvtThemeIcon(const QString &name)
{
    return QIcon::fromTheme(name, kvtBundledIcon(name));
}

Q_COREAPP_STARTUP_FUNCTION(startLibrary)
