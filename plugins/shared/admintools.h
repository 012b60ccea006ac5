// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Small helpers shared by the kvt-admin plugins (header only: each plugin is
// a shared object of its own).

#ifndef KVT_ADMIN_TOOLS_H
#define KVT_ADMIN_TOOLS_H

#include <kvt-common/element.h>
#include <kvt-common/module.h>

#include <QCoreApplication>
#include <QPointer>
#include <QProcess>
#include <QString>
#include <QStringList>
#include <QVariant>

namespace KvtAdmin {

/*!
 * Whether \a name may be handed to an external program as a single
 * argument naming a user, a group or a service: not empty, no leading "-"
 * (it would be read as an option), no "/" (it would name a path), no white
 * space and no control characters.
 */
inline bool isSafeName(const QString &name)
{
    if (name.isEmpty() || name.startsWith(QLatin1Char('-')) || name.size() > 255)
        return false;
    for (const QChar c : name) {
        if (c.category() == QChar::Other_Control || c.isSpace() || c == QLatin1Char('/'))
            return false;
    }
    return true;
}

/*! Whether \a text may be handed to a program as an argument value (a
 *  GECOS field...): no control characters, no leading "-". Empty is fine. */
inline bool isSafeText(const QString &text)
{
    if (text.startsWith(QLatin1Char('-')))
        return false;
    for (const QChar c : text) {
        if (c.category() == QChar::Other_Control)
            return false;
    }
    return true;
}

/*! True when kvt-admin runs with --allow-changes. */
inline bool changesAllowed()
{
    return QCoreApplication::instance()
           && QCoreApplication::instance()->property("kvtAdminAllowChanges").toBool();
}

/*! Rights predicate of modules that change the machine: the administrator
 *  check of the library, and the tool started with --allow-changes. */
inline bool mayChangeSystem(const Module &module)
{
    return changesAllowed() && Module::isAdministrator(module);
}

/*!
 * The outcome of one external program run without a shell.
 */
struct ProgramResult
{
    bool finished = false; //!< started, ended normally within the time limit
    int exitCode = -1;
    QString output;        //!< standard output
    QString error;         //!< standard error, or why the program did not run

    bool ok() const { return finished && exitCode == 0; }
    /*! The program's own message when it failed, else a fallback. */
    QString message(const QString &program) const
    {
        if (!finished)
            return QCoreApplication::translate("KvtAdmin", "%1: %2").arg(program, error);
        const QString text = error.trimmed().isEmpty() ? output.trimmed() : error.trimmed();
        if (!text.isEmpty())
            return text;
        return QCoreApplication::translate("KvtAdmin", "%1 ended with exit code %2")
            .arg(program)
            .arg(exitCode);
    }
};

/*!
 * Runs \a program with \a arguments (no shell: nothing is split or
 * expanded), writes \a input to its standard input and closes it, and waits
 * at most \a timeout milliseconds. A program still running then is killed.
 * Safe to call on a worker thread.
 */
inline ProgramResult runProgram(const QString &program, const QStringList &arguments,
                                const QByteArray &input = QByteArray(), int timeout = 30000)
{
    ProgramResult result;
    QProcess process;
    process.start(program, arguments, input.isNull() ? QIODevice::ReadOnly : QIODevice::ReadWrite);
    if (!process.waitForStarted(timeout)) {
        result.error = process.errorString();
        return result;
    }
    if (!input.isNull()) {
        process.write(input);
        process.closeWriteChannel();
    }
    if (!process.waitForFinished(timeout)) {
        result.error = QCoreApplication::translate("KvtAdmin", "did not finish within %1 s")
                           .arg(timeout / 1000);
        process.kill();
        process.waitForFinished(1000);
        return result;
    }
    result.output = QString::fromLocal8Bit(process.readAllStandardOutput());
    result.error = QString::fromLocal8Bit(process.readAllStandardError());
    if (process.exitStatus() == QProcess::CrashExit) {
        result.error = QCoreApplication::translate("KvtAdmin", "crashed");
        return result;
    }
    result.finished = true;
    result.exitCode = process.exitCode();
    return result;
}

/*!
 * A library task whose afterRun() is skipped once its element is gone: a
 * task can outlive the element it was made for (the plugin is unloaded or
 * the element list re-read while the task waits in the queue), and the
 * library's afterRun() would then touch a deleted element. \a Base must
 * define afterRun() (not the abstract ElementTask).
 */
template <class Base>
class ElementGuarded : public Base
{
public:
    template <class... Args>
    explicit ElementGuarded(Element *element, Args &&...args)
        : Base(element, std::forward<Args>(args)...)
        , _guard(element)
    {
    }

    void afterRun() override
    {
        if (_guard)
            Base::afterRun();
    }

protected:
    bool elementAlive() const { return !_guard.isNull(); }

private:
    QPointer<Element> _guard;
};

} // namespace KvtAdmin

#endif // KVT_ADMIN_TOOLS_H
