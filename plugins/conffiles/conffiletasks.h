// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef CONFFILES_CONFFILETASKS_H
#define CONFFILES_CONFFILETASKS_H

#include "conffileformat.h"

#include <kvt-common/createtask.h>
#include <kvt-common/deletetask.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/updatetask.h>

#include <QPointer>

class FileElement;
class KeyElement;

// The tasks of the plugin. Each one copies what it needs from its element
// in the interface thread (its constructor), works on the file alone in
// run(), and hands the outcome back in afterRun() only if its element still
// exists. Writes to one file are serialised.

//! Reads the key lines of a file.
class ReadFileTask : public ReadContentTask
{
public:
    //! \a created, when given, names a key to select after the read (owned).
    ReadFileTask(FileElement *file, ElementData *created);
    void run() override;
    void afterRun() override;

private:
    QPointer<FileElement> _file;
    QString _path;
    ConfFileScan _scan;
};

//! Reads one key line for its widget.
class ReadKeyTask : public ReadPropertyHeavyTask
{
public:
    explicit ReadKeyTask(KeyElement *key);
    void run() override;
    void afterRun() override;

private:
    QPointer<KeyElement> _key;
    QString _path;
    ConfEntry _entry;
};

//! Rewrites one key line with the value and comment of the record.
class UpdateKeyTask : public UpdateTask
{
public:
    UpdateKeyTask(KeyElement *key, ElementData *data);
    void run() override;
    void afterRun() override;

private:
    QPointer<KeyElement> _key;
    QString _path;
    ConfEntry _entry;
};

//! Appends a key line to a file.
class CreateKeyTask : public CreateTask
{
public:
    CreateKeyTask(FileElement *file, ElementData *data);
    void run() override;
    void afterRun() override;

private:
    QPointer<FileElement> _file;
    QString _path;
    ConfEntry _created;
};

//! Removes one key line.
class DeleteKeyTask : public DeleteTask
{
public:
    explicit DeleteKeyTask(KeyElement *key);
    void run() override;
    void afterRun() override;

private:
    QPointer<KeyElement> _key;
    QString _path;
    ConfEntry _entry;
};

#endif
