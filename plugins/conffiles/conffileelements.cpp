// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "conffileelements.h"

#include "keywidget.h"

#include <kvt-common/module.h>

#include <QFileInfo>
#include <QHash>
#include <QIcon>

FileElement::FileElement(Module &module, const QString &path)
    : ContainerElement(module, Module::defaultTrue)
{
    _elementType = ConfFileTypes::file();
    // Title first: a laid-out (persistent) element keeps the title it has.
    setTitle(path);
    _expectedDepth = 1;
}

FileElement::~FileElement() = default;

QString FileElement::toolTipText() const
{
    return path();
}

QVariant FileElement::data(int column, int role) const
{
    if (column == 0 && role == Qt::DisplayRole)
        return QFileInfo(path()).fileName();
    if (column == 0 && role == Qt::DecorationRole)
        return QIcon::fromTheme(QStringLiteral("text-x-generic"));
    return ContainerElement::data(column, role);
}

ElementWidget *FileElement::elementWidget(ElementWidgetRole role)
{
    if (role != CreateElementRole)
        return nullptr;
    auto *widget = qobject_cast<KeyWidget *>(_module.elementWidget(ConfFileTypes::key()));
    if (widget)
        widget->setCreateTarget(this);
    return widget;
}

void FileElement::applyScan(const ConfFileScan &scan)
{
    _separator = ConfFileFormat::usualSeparator(scan);
    _lineEnd = scan.lineEnd;
    _endsWithNewline = scan.endsWithNewline;
    _lineCount = scan.lineCount;

    QHash<QPair<QString, int>, KeyElement *> existing;
    QList<KeyElement *> current;
    for (TreeNode *node : qAsConst(_childNodes)) {
        if (auto *key = qobject_cast<KeyElement *>(node)) {
            existing.insert(qMakePair(key->entry().key, key->entry().occurrence), key);
            current.append(key);
        }
    }
    QList<KeyElement *> wanted;
    for (const ConfEntry &entry : scan.entries) {
        KeyElement *key = existing.take(qMakePair(entry.key, entry.occurrence));
        if (key)
            key->setEntry(entry);
        else
            key = new KeyElement(_module, entry);
        wanted.append(key);
    }
    if (wanted != current) {
        // The order changed or keys came and went: one removal and one
        // insertion of the whole list keep the views' bookkeeping simple.
        if (!_childNodes.isEmpty())
            removeAt(0, _childNodes.size());
        QList<TreeNode *> nodes;
        for (KeyElement *key : qAsConst(wanted))
            nodes.append(key);
        if (!nodes.isEmpty())
            insert(0, nodes);
    }
    // Elements whose line is gone are out of the tree now.
    qDeleteAll(existing);
}

KeyElement *FileElement::appendEntry(const ConfEntry &entry)
{
    auto *key = new KeyElement(_module, entry);
    append(key);
    ++_lineCount;
    _endsWithNewline = true;
    return key;
}

void FileElement::lineRemoved(const ConfEntry &removed)
{
    for (TreeNode *node : qAsConst(_childNodes)) {
        auto *key = qobject_cast<KeyElement *>(node);
        if (!key)
            continue;
        ConfEntry entry = key->entry();
        bool moved = false;
        if (entry.lineNumber > removed.lineNumber) {
            --entry.lineNumber;
            moved = true;
        }
        if (entry.key == removed.key && entry.occurrence > removed.occurrence) {
            --entry.occurrence;
            moved = true;
        }
        if (moved)
            key->setEntry(entry);
    }
    --_lineCount;
}

KeyElement::KeyElement(Module &module, const ConfEntry &entry)
    : OrdinaryElement(module, Module::defaultTrue)
    , _entry(entry)
{
    _elementType = ConfFileTypes::key();
    setTitle(entry.key);
}

KeyElement::~KeyElement() = default;

void KeyElement::setEntry(const ConfEntry &entry)
{
    const bool shown = entry.value != _entry.value || entry.key != _entry.key;
    _entry = entry;
    if (shown)
        emitNodeDataChanged();
}

FileElement *KeyElement::file() const
{
    return qobject_cast<FileElement *>(_parentNode);
}

quint64 KeyElement::availableOperations() const
{
    quint64 operations = OrdinaryElement::availableOperations();
    if (!_entry.problem.isEmpty())
        operations &= ~quint64(UpdateOperation);
    return operations;
}

QString KeyElement::toolTipText() const
{
    QString text = tr("Line %1: %2").arg(_entry.lineNumber).arg(QString::fromLocal8Bit(_entry.raw).trimmed());
    if (!_entry.problem.isEmpty())
        text += QLatin1Char('\n') + _entry.problem;
    return text;
}

QVariant KeyElement::data(int column, int role) const
{
    if (column == 0 && role == Qt::DisplayRole) {
        // A long value is cut for the tree; the widget shows it whole.
        QString value = _entry.value;
        if (value.size() > 80)
            value = value.left(77) + QStringLiteral("...");
        return value.isEmpty() ? _entry.key : QStringLiteral("%1 = %2").arg(_entry.key, value);
    }
    return OrdinaryElement::data(column, role);
}

ElementWidget *KeyElement::elementWidget(ElementWidgetRole role)
{
    ElementWidget *widget = OrdinaryElement::elementWidget(role);
    if (role == CreateElementRole) {
        if (auto *keyWidget = qobject_cast<KeyWidget *>(widget))
            keyWidget->setCreateTarget(file());
    }
    return widget;
}
