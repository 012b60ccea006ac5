// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementselementwidget.h"

#include "element.h"
#include "elementmodel.h"
#include "elementswidgetproxymodel.h"
#include "listelementwidgetform_p.h"
#include "module.h"
#include "ui_elementselementwidget.h"

#include <QHeaderView>
#include <QSettings>

namespace {

using Form = ListElementWidgetFormOf<Ui::ElementsElementWidget>;

enum FilterMode { WildcardFilter = 0, RegExpFilter = 1, FixedStringFilter = 2 };

// The element type and the key name run together without a separator:
// settings written by earlier versions use exactly these keys.
QString settingsKey(const QString &type, const char *name)
{
    return QStringLiteral("%1%2").arg(QStringLiteral("elementsElementWidget/%1").arg(type),
                                      QLatin1String(name));
}

} // namespace

ElementsElementWidget::ElementsElementWidget(const QString &type, Module &module,
                                             RightsPredicate check, QWidget *parent)
    : ListElementWidget(type, module, check, parent)
{
    auto *form = new Form;
    _ui = form;
    form->setupUi(this);
    _proxy = new ElementsWidgetProxyModel(1, this);
    _proxy->setFilterCaseSensitivity(Qt::CaseInsensitive);
    _proxy->setDynamicSortFilter(true);
    _proxy->setSourceModel(_model);
    form->_elementTreeView->setModel(_proxy);
    connectView();
    connect(form->_patternLineEdit, SIGNAL(textChanged( QString )), this, SLOT(changeFilter()));
    connect(form->_patternTypeComboBox, SIGNAL(currentIndexChanged( int )), this,
            SLOT(changeFilter()));
}

ElementsElementWidget::~ElementsElementWidget()
{
    // A widget never read has nothing of its own to keep, and must not
    // overwrite what another widget of the same type saved.
    if (_model->rootNode())
        saveSettings();
}

void ElementsElementWidget::read()
{
    if (_role != EditElementRole || !_element
        || !(_element->availableOperations() & ReadContentOperation))
        return;
    if (!_model->rootNode()) {
        _model->setRootNode(_element);
        // The header has the root's columns only from now on.
        loadSettings();
        return;
    }
    if (_module.getData(QStringLiteral("paranoid")).toBool() || _element->canFetchMore())
        _element->performOperation(ReadContentOperation, nullptr, 0);
}

void ElementsElementWidget::loadSettings()
{
    auto *form = static_cast<Form *>(_ui);
    const QSettings settings;
    const QByteArray header = settings.value(settingsKey(_elementType, "HeaderState")).toByteArray();
    if (!header.isEmpty())
        form->_elementTreeView->header()->restoreState(header);
    bool ok = false;
    const int type = settings.value(settingsKey(_elementType, "FilterType")).toInt(&ok);
    // An index this version does not know keeps the default mode.
    if (ok && type >= 0 && type < form->_patternTypeComboBox->count())
        form->_patternTypeComboBox->setCurrentIndex(type);
    form->_patternLineEdit->setText(settings.value(settingsKey(_elementType, "FilterValue")).toString());
}

void ElementsElementWidget::saveSettings() const
{
    const auto *form = static_cast<const Form *>(_ui);
    QSettings settings;
    settings.setValue(settingsKey(_elementType, "HeaderState"),
                      form->_elementTreeView->header()->saveState());
    settings.setValue(settingsKey(_elementType, "FilterType"),
                      form->_patternTypeComboBox->currentIndex());
    settings.setValue(settingsKey(_elementType, "FilterValue"), form->_patternLineEdit->text());
}

void ElementsElementWidget::changeFilter()
{
    const auto *form = static_cast<const Form *>(_ui);
    const QString text = form->_patternLineEdit->text();
    switch (form->_patternTypeComboBox->currentIndex()) {
    case WildcardFilter:
        _proxy->setFilterWildcard(text);
        break;
    case RegExpFilter:
        _proxy->setFilterRegExp(text);
        break;
    case FixedStringFilter:
        _proxy->setFilterFixedString(text);
        break;
    default:
        break;
    }
}

void ElementsElementWidget::choiceElement(const QModelIndex &index)
{
    chooseElement(index);
}

void ElementsElementWidget::customContextMenuRequest(const QPoint &pos)
{
    relayContextMenuRequest(pos);
}
