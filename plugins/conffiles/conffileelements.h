// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef CONFFILES_CONFFILEELEMENTS_H
#define CONFFILES_CONFFILEELEMENTS_H

#include "conffileformat.h"

#include <kvt-common/containerelement.h>
#include <kvt-common/ordinaryelement.h>

class KeyElement;

//! Element types of the plugin: the widget of a type is registered under it.
namespace ConfFileTypes {
inline QString file() { return QStringLiteral("conffile"); }
inline QString key() { return QStringLiteral("confkey"); }
}

/*!
 * A managed file: a container whose children, the key lines, are read when
 * it is first expanded. Its title is the file's path; the tree shows the
 * file name.
 */
class FileElement : public ContainerElement
{
    Q_OBJECT

public:
    FileElement(Module &module, const QString &path);
    ~FileElement() override;

    QString path() const { return title(); }
    QString toolTipText() const override;
    QVariant data(int column, int role) const override;
    //! The create role gives the key widget, set to create a key in this file.
    ElementWidget *elementWidget(ElementWidgetRole role) override;

    //! Takes the outcome of a read: keeps the key elements still there
    //! (with their new line), adds new ones, removes the others, in file order.
    void applyScan(const ConfFileScan &scan);
    //! A key line was appended by this tool; returns its element.
    KeyElement *appendEntry(const ConfEntry &entry);
    //! A line was deleted by this tool: later lines move up.
    void lineRemoved(const ConfEntry &entry);

    QString separator() const { return _separator; }
    QByteArray lineEnd() const { return _lineEnd; }
    bool endsWithNewline() const { return _endsWithNewline; }
    int lineCount() const { return _lineCount; }

private:
    QString _separator = QStringLiteral(" = ");
    QByteArray _lineEnd = QByteArrayLiteral("\n");
    bool _endsWithNewline = true;
    int _lineCount = 0;
};

/*!
 * One key line of a file. Shown as "key = value"; its title is the key.
 * A line that cannot be written back unchanged (not valid text, too long)
 * offers no update.
 */
class KeyElement : public OrdinaryElement
{
    Q_OBJECT

public:
    KeyElement(Module &module, const ConfEntry &entry);
    ~KeyElement() override;

    const ConfEntry &entry() const { return _entry; }
    void setEntry(const ConfEntry &entry);
    FileElement *file() const;

    quint64 availableOperations() const override;
    QString toolTipText() const override;
    QVariant data(int column, int role) const override;
    //! The create role gives the key widget, set to create a key in this
    //! key's file.
    ElementWidget *elementWidget(ElementWidgetRole role) override;

private:
    ConfEntry _entry;
};

#endif
