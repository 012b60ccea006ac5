// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "conffiletasks.h"

#include "conffileelements.h"

#include <kvt-common/elementdata.h>
#include <kvt-common/elementwidget.h>
#include <kvt-common/module.h>

#include <QCoreApplication>
#include <QFileInfo>
#include <QMutex>
#include <QMutexLocker>

#include <exception>
#include <map>
#include <memory>

namespace {

QString tr(const char *text)
{
    return QCoreApplication::translate("ConfFileTasks", text);
}

// Two rewrites of one file would share its work copy: every task holds the
// file's lock while it reads or writes it.
QMutex &fileLock(const QString &path)
{
    static QMutex guard;
    static std::map<QString, std::unique_ptr<QMutex>> locks;
    QMutexLocker locker(&guard);
    std::unique_ptr<QMutex> &lock = locks[QFileInfo(path).absoluteFilePath()];
    if (!lock)
        lock = std::make_unique<QMutex>();
    return *lock;
}

void finish(TaskDescription &description, TaskDescription::TaskStatus status, const QString &message)
{
    description.setStatus(status);
    description.setMessage(message);
}

bool forceReread(const Element *element)
{
    return element->module().getData(QStringLiteral("paranoid")).toBool();
}

// Finds the line a task was started for, as it was read: false with a
// message when it is gone or changed meanwhile.
bool lineStillThere(const QString &path, const ConfEntry &entry, QString &error)
{
    ConfFileScan scan;
    if (!ConfFileFormat::scan(path, scan, error))
        return false;
    const ConfEntry *now = ConfFileFormat::find(scan, entry.key, entry.occurrence);
    if (!now || now->raw != entry.raw) {
        error = tr("Line %1 of \"%2\" (key \"%3\") changed on disk since it was read; nothing was written. "
                   "Read the file again.")
                    .arg(entry.lineNumber)
                    .arg(path, entry.key);
        return false;
    }
    return true;
}

} // namespace

ReadFileTask::ReadFileTask(FileElement *file, ElementData *created)
    : ReadContentTask(file)
    , _file(file)
    , _path(file->path())
{
    _elementData = created;
    _taskDescription.setDescription(tr("Read \"%1\"").arg(_path));
}

void ReadFileTask::run()
{
    try {
        QMutexLocker locker(&fileLock(_path));
        QString error;
        if (!ConfFileFormat::scan(_path, _scan, error))
            finish(_taskDescription, TaskDescription::Fail, error);
        else if (!_scan.warnings.isEmpty())
            finish(_taskDescription, TaskDescription::Warning, _scan.warnings.join(QLatin1Char('\n')));
        else
            finish(_taskDescription, TaskDescription::Success, QString());
    } catch (const std::exception &e) {
        finish(_taskDescription, TaskDescription::Fail, QString::fromLocal8Bit(e.what()));
    }
    AbstractTask::run();
}

void ReadFileTask::afterRun()
{
    // The file element went while the task ran (the plugins were unloaded).
    if (!_file)
        return;
    if (_taskDescription.status() != TaskDescription::Fail)
        _file->applyScan(_scan);
    ReadContentTask::afterRun();
}

ReadKeyTask::ReadKeyTask(KeyElement *key)
    : ReadPropertyHeavyTask(key)
    , _key(key)
    , _path(key->file() ? key->file()->path() : QString())
    , _entry(key->entry())
{
    _elementData = new ElementData;
    _taskDescription.setDescription(tr("Read \"%1\" in \"%2\"").arg(_entry.key, _path));
}

void ReadKeyTask::run()
{
    try {
        QMutexLocker locker(&fileLock(_path));
        ConfFileScan scan;
        QString error;
        if (!ConfFileFormat::scan(_path, scan, error)) {
            finish(_taskDescription, TaskDescription::Fail, error);
        } else if (const ConfEntry *entry = ConfFileFormat::find(scan, _entry.key, _entry.occurrence)) {
            _entry = *entry;
            _elementData->setName(entry->key);
            _elementData->insert(QStringLiteral("value"), entry->value);
            _elementData->insert(QStringLiteral("comment"), entry->comment);
            _elementData->insert(QStringLiteral("line"), entry->lineNumber);
            _elementData->insert(QStringLiteral("file"), _path);
            finish(_taskDescription, TaskDescription::Success, QString());
        } else {
            finish(_taskDescription, TaskDescription::Fail,
                   tr("\"%1\" no longer sets \"%2\"; read the file again.").arg(_path, _entry.key));
        }
    } catch (const std::exception &e) {
        finish(_taskDescription, TaskDescription::Fail, QString::fromLocal8Bit(e.what()));
    }
    AbstractTask::run();
}

void ReadKeyTask::afterRun()
{
    if (!_key)
        return;
    if (_taskDescription.status() != TaskDescription::Fail)
        _key->setEntry(_entry);
    ReadPropertyHeavyTask::afterRun();
}

UpdateKeyTask::UpdateKeyTask(KeyElement *key, ElementData *data)
    : UpdateTask(key, data)
    , _key(key)
    , _path(key->file() ? key->file()->path() : QString())
    , _entry(key->entry())
{
    _taskDescription.setDescription(tr("Change \"%1\" in \"%2\"").arg(_entry.key, _path));
}

void UpdateKeyTask::run()
{
    try {
        const QString value = _elementData ? _elementData->value(QStringLiteral("value")).toString() : QString();
        const QString comment = _elementData ? _elementData->value(QStringLiteral("comment")).toString() : QString();
        QString error = _entry.problem;
        if (error.isEmpty())
            error = ConfFileFormat::valueProblem(value);
        if (error.isEmpty())
            error = ConfFileFormat::commentProblem(comment);
        QMutexLocker locker(&fileLock(_path));
        if (error.isEmpty() && lineStillThere(_path, _entry, error)) {
            const QByteArray line = ConfFileFormat::rewrittenLine(_entry, value, comment);
            ConfFileFormat::LineRewriter rewriter(_entry.key, _entry.occurrence, _entry.raw, line);
            if (RegExpHandler::rewriteSystemConfigureFile(_path, rewriter, error, true)) {
                if (rewriter.done()) {
                    _entry.hasComment = (_entry.hasComment && comment == _entry.comment) || !comment.isEmpty();
                    _entry.value = value;
                    _entry.comment = comment;
                    _entry.raw = line;
                } else {
                    error = tr("Line %1 of \"%2\" changed on disk while it was written; it was kept as it "
                               "was. Read the file again.").arg(_entry.lineNumber).arg(_path);
                }
            }
        }
        if (error.isEmpty())
            finish(_taskDescription, TaskDescription::Success,
                   tr("Line %1 of \"%2\" written.").arg(_entry.lineNumber).arg(_path));
        else
            finish(_taskDescription, TaskDescription::Fail, error);
    } catch (const std::exception &e) {
        finish(_taskDescription, TaskDescription::Fail, QString::fromLocal8Bit(e.what()));
    }
    AbstractTask::run();
}

void UpdateKeyTask::afterRun()
{
    if (!_key)
        return;
    if (_taskDescription.status() != TaskDescription::Fail)
        _key->setEntry(_entry);
    // Outside force reread mode the base clears the changes of the edit
    // widget; when the widget shows another key by now (the user applied on
    // leaving), those changes are that key's and stay.
    auto *widget = qobject_cast<ElementWidget *>(_key->elementWidget(EditElementRole));
    if (!forceReread(_key) && widget && widget->element() != _key)
        return;
    UpdateTask::afterRun();
}

CreateKeyTask::CreateKeyTask(FileElement *file, ElementData *data)
    : CreateTask(file, data)
    , _file(file)
    , _path(file->path())
{
    _taskDescription.setDescription(tr("Add \"%1\" to \"%2\"").arg(data ? data->name() : QString(), _path));
}

void CreateKeyTask::run()
{
    try {
        const QString key = _elementData ? _elementData->name() : QString();
        const QString value = _elementData ? _elementData->value(QStringLiteral("value")).toString() : QString();
        const QString comment = _elementData ? _elementData->value(QStringLiteral("comment")).toString() : QString();
        QString error = ConfFileFormat::keyProblem(key);
        if (error.isEmpty())
            error = ConfFileFormat::valueProblem(value);
        if (error.isEmpty())
            error = ConfFileFormat::commentProblem(comment);
        QMutexLocker locker(&fileLock(_path));
        ConfFileScan scan;
        if (error.isEmpty() && ConfFileFormat::scan(_path, scan, error)) {
            if (const ConfEntry *existing = ConfFileFormat::find(scan, key, 0)) {
                error = tr("\"%1\" already sets \"%2\" (line %3); nothing was added.")
                            .arg(_path, key)
                            .arg(existing->lineNumber);
            } else {
                _created.key = key;
                _created.separator = ConfFileFormat::usualSeparator(scan);
                _created.value = value;
                _created.comment = comment;
                _created.hasComment = !comment.isEmpty();
                _created.lineNumber = scan.lineCount + 1;
                _created.raw = ConfFileFormat::newLine(key, _created.separator, value, comment, scan.lineEnd);
                // A last line without its line end gets one first.
                const QByteArray tail = (scan.endsWithNewline ? QByteArray() : scan.lineEnd) + _created.raw;
                ConfFileFormat::LineAppender appender(key, tail);
                if (RegExpHandler::rewriteSystemConfigureFile(_path, appender, error, true)
                    && !appender.appended())
                    error = tr("\"%1\" was given \"%2\" meanwhile; nothing was added.").arg(_path, key);
            }
        }
        if (error.isEmpty())
            finish(_taskDescription, TaskDescription::Success, tr("\"%1\" added to \"%2\".").arg(key, _path));
        else
            finish(_taskDescription, TaskDescription::Fail, error);
    } catch (const std::exception &e) {
        finish(_taskDescription, TaskDescription::Fail, QString::fromLocal8Bit(e.what()));
    }
    AbstractTask::run();
}

void CreateKeyTask::afterRun()
{
    if (!_file)
        return;
    const bool succeeded = _taskDescription.status() != TaskDescription::Fail;
    const bool reread = forceReread(_file);
    CreateTask::afterRun();
    // Outside force reread mode the result is trusted: the new line is shown
    // at once (a file never read yet shows it when it is read).
    if (succeeded && !reread && !_file->requireLoad())
        _file->appendEntry(_created)->emitSetCurrentNode();
}

DeleteKeyTask::DeleteKeyTask(KeyElement *key)
    : DeleteTask(key)
    , _key(key)
    , _path(key->file() ? key->file()->path() : QString())
    , _entry(key->entry())
{
    _taskDescription.setDescription(tr("Remove \"%1\" from \"%2\"").arg(_entry.key, _path));
}

void DeleteKeyTask::run()
{
    try {
        QString error;
        QMutexLocker locker(&fileLock(_path));
        if (lineStillThere(_path, _entry, error)) {
            ConfFileFormat::LineRewriter rewriter(_entry.key, _entry.occurrence, _entry.raw, QByteArray());
            if (RegExpHandler::rewriteSystemConfigureFile(_path, rewriter, error, true) && !rewriter.done())
                error = tr("Line %1 of \"%2\" changed on disk while it was written; it was kept as it was. "
                           "Read the file again.").arg(_entry.lineNumber).arg(_path);
        }
        if (error.isEmpty())
            finish(_taskDescription, TaskDescription::Success,
                   tr("Line %1 removed from \"%2\".").arg(_entry.lineNumber).arg(_path));
        else
            finish(_taskDescription, TaskDescription::Fail, error);
    } catch (const std::exception &e) {
        finish(_taskDescription, TaskDescription::Fail, QString::fromLocal8Bit(e.what()));
    }
    AbstractTask::run();
}

void DeleteKeyTask::afterRun()
{
    if (!_key)
        return;
    const bool succeeded = _taskDescription.status() != TaskDescription::Fail;
    const bool reread = forceReread(_key);
    QPointer<FileElement> file = _key->file();
    if (succeeded && file && !reread)
        file->lineRemoved(_entry);
    DeleteTask::afterRun();
    // In force reread mode the library leaves the element in place: the
    // file is read again, which drops it.
    if (succeeded && file && reread)
        file->performOperation(ReadContentOperation, nullptr, 0);
}
