#include "regexphandler.h"

#include <QFile>
#include <QObject>
#include <QProcess>
#include <QStringList>

namespace {

const int copyTimeoutMs = 30000;

void appendError(QString &error, const QString &message)
{
    if (!error.isEmpty())
        error += QLatin1Char('\n');
    error += message;
}

void appendNotExists(QString &error, const QString &fileName)
{
    appendError(error, QObject::tr("\"%1\" not exists").arg(fileName));
}

void appendFileError(QString &error, const QFileDevice &file)
{
    appendError(error, QObject::tr("\"%1\" error %2\n%3")
                           .arg(file.fileName(), QString::number(int(file.error())), file.errorString()));
}

// One line of the file as the traversals see it.
struct Line
{
    QString decoded;
    int commentStart = -1; // position of the first '#' in decoded, or -1
};

// Decodes \a raw and tells whether it is a candidate whose text before the
// comment matches the handler's expression. No quoting is understood: a '#'
// inside a quoted value starts the comment all the same.
bool matches(RegExpHandler &handler, const QByteArray &raw, Line &line)
{
    line.decoded = QString::fromLocal8Bit(raw);
    line.commentStart = line.decoded.indexOf(QLatin1Char('#'));
    const QString text = (line.commentStart < 0 ? line.decoded : line.decoded.left(line.commentStart)).trimmed();
    if (text.isEmpty())
        return false;
    return handler.regExp().indexIn(text, 0) != -1;
}

} // namespace

RegExpHandler::RegExpHandler(const QString &pattern)
    : _regExp(pattern, Qt::CaseSensitive, QRegExp::RegExp)
{
}

RegExpHandler::~RegExpHandler() = default;

bool RegExpHandler::finalHandleRegExp(QByteArray *tail)
{
    Q_UNUSED(tail)
    return false;
}

bool RegExpHandler::readSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error)
{
    if (!QFile::exists(fileName)) {
        appendNotExists(error, fileName);
        return false;
    }
    QFile file(fileName);
    if (!file.open(QIODevice::ReadOnly)) {
        appendFileError(error, file);
        return false;
    }
    Line line;
    while (!file.atEnd()) {
        const QByteArray raw = file.readLine();
        if (matches(handler, raw, line))
            handler.handleRegExp(nullptr);
    }
    file.close();
    return true;
}

bool RegExpHandler::rewriteSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error,
                                               bool backup)
{
    if (!QFile::exists(fileName)) {
        appendNotExists(error, fileName);
        return false;
    }

    // The work copy starts as a cp of the file, so it already has the file's
    // mode and owner; a stale one from an earlier failure is overwritten.
    const QString workName = QStringLiteral("%1.tmp").arg(fileName);
    if (!safeCopy(fileName, workName, error))
        return false;

    QFile target(fileName);
    if (!target.open(QIODevice::ReadOnly)) {
        appendFileError(error, target);
        return false;
    }
    QFile work(workName);
    if (!work.open(QIODevice::WriteOnly)) {
        target.close();
        appendFileError(error, work);
        return false;
    }

    Line line;
    while (!target.atEnd()) {
        QByteArray raw = target.readLine();
        if (!matches(handler, raw, line)) {
            work.write(raw);
            continue;
        }
        const bool replaced = handler.handleRegExp(&raw);
        work.write(raw);
        if (replaced) {
            // The handler gave bare content: put the line's comment back and
            // end the line.
            if (line.commentStart >= 0) {
                const QString comment = line.decoded.mid(line.commentStart).trimmed();
                if (!comment.isEmpty()) {
                    work.write("\t", 1);
                    work.write(comment.toLocal8Bit());
                }
            }
            work.write("\n", 1);
        }
    }

    QByteArray tail;
    if (handler.finalHandleRegExp(&tail))
        work.write(tail);

    // A work copy that could not be written completely (a full disk) must
    // never be copied over the file.
    const bool readFailed = target.error() != QFileDevice::NoError;
    work.close();
    const bool writeFailed = work.error() != QFileDevice::NoError;
    target.close();
    if (writeFailed) {
        appendFileError(error, work);
        return false;
    }
    if (readFailed) {
        appendFileError(error, target);
        return false;
    }

    if (backup) {
        const QString backupName = QStringLiteral("%1.bak").arg(fileName);
        if (QFile::exists(backupName))
            QFile::remove(backupName);
        if (!target.copy(backupName)) {
            appendFileError(error, target);
            return false;
        }
    }

    if (!safeCopy(workName, fileName, error))
        return false;

    if (!work.remove()) {
        // The file already has its new content; only the clean-up failed.
        appendFileError(error, work);
        return false;
    }
    return true;
}

bool RegExpHandler::safeCopy(const QString &source, const QString &destination, QString &error)
{
    const QString program = QStringLiteral("cp");
    const QStringList arguments{QStringLiteral("--force"), QStringLiteral("--preserve=mode,ownership"), source,
                                destination};
    const QString joined = arguments.join(QLatin1Char(' '));

    // No shell: the paths reach cp exactly as given.
    QProcess process;
    process.start(program, arguments, QIODevice::ReadOnly);
    if (!process.waitForStarted(copyTimeoutMs)) {
        appendError(error, QObject::tr("Process: \"%1 %2\". Error: %3.\n\"Not started\"")
                               .arg(program, joined, process.errorString()));
        return false;
    }
    if (!process.waitForFinished(copyTimeoutMs) || process.exitStatus() == QProcess::CrashExit) {
        appendError(error, QObject::tr("Process: \"%1 %2\". Error: %3.\n\"Not finished\"")
                               .arg(program, joined, process.errorString()));
        return false;
    }
    if (process.exitCode() != 0) {
        const QString errorText = QString::fromLocal8Bit(process.readAllStandardError()).trimmed();
        appendError(error, QObject::tr("Process: \"%1 %2\". Exit code: %3.\n\"%4\"")
                               .arg(program, joined, QString::number(process.exitCode()), errorText));
        return false;
    }
    return true;
}
