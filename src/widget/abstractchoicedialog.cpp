// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "abstractchoicedialog.h"
#include "ui_abstractchoicedialog.h"

#include "changedisplayelementdata.h"
#include "element.h"
#include "filtertreenodesortfilterproxymodel.h"

#include <QHeaderView>
#include <QPushButton>

AbstractChoiceDialog::AbstractChoiceDialog(QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::AbstractChoiceDialog)
    , _model(nullptr)
{
    _ui->setupUi(this);
    _ui->_nodeTreeView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    _ui->_buttonBox->button(QDialogButtonBox::Ok)->setEnabled(false);

    connect(_ui->_buttonBox, SIGNAL(accepted()), this, SLOT(accept()));
    connect(_ui->_buttonBox, SIGNAL(accepted()), this, SLOT(choice()));
    connect(_ui->_buttonBox, SIGNAL(rejected()), this, SLOT(reject()));
    connect(_ui->_patternTypeComboBox, SIGNAL(currentIndexChanged(int)), this, SLOT(changeFilter()));
    connect(_ui->_patternLineEdit, SIGNAL(textChanged(QString)), this, SLOT(changeFilter()));
    connect(_ui->_displayVariantComboBox, SIGNAL(currentIndexChanged( int )),
            this, SLOT(changeDisplayVariant( int )));
}

AbstractChoiceDialog::~AbstractChoiceDialog()
{
    delete _ui;
}

void AbstractChoiceDialog::setAcceptColumns(const QSet<int> &columns)
{
    _acceptColumns = columns;
    if (_model)
        _model->setAcceptColumns(columns);
}

void AbstractChoiceDialog::afterConstructor()
{
    if (!_model)
        return;
    _model->setAcceptColumns(_acceptColumns);
    _model->setDynamicSortFilter(true);
    _ui->_nodeTreeView->setModel(_model);
    connect(_ui->_nodeTreeView->selectionModel(), SIGNAL(selectionChanged( QItemSelection, QItemSelection )),
            this, SLOT(selectionChanged()));
}

void AbstractChoiceDialog::choice()
{
    makeChoice();
}

void AbstractChoiceDialog::changeFilter()
{
    if (!_model)
        return;
    const QString text = _ui->_patternLineEdit->text();
    switch (_ui->_patternTypeComboBox->currentIndex()) {
    case 0:
        _model->setFilterWildcard(text);
        break;
    case 1:
        _model->setFilterRegExp(text);
        break;
    case 2:
        _model->setFilterFixedString(text);
        break;
    default:
        break;
    }
}

void AbstractChoiceDialog::changeDisplayVariant(int index)
{
    Element *element = displayElement();
    if (!element || index < 0)
        return;
    // The element only reads the record; it stays ours.
    ChangeDisplayElementData data(index);
    element->performOperation(ChangeDisplayOperation, &data, 0);
}

void AbstractChoiceDialog::selectionChanged()
{
    const QItemSelectionModel *selection = _ui->_nodeTreeView->selectionModel();
    _ui->_buttonBox->button(QDialogButtonBox::Ok)->setEnabled(selection && selection->hasSelection());
}

void AbstractChoiceDialog::showEvent(QShowEvent *event)
{
    QComboBox *box = _ui->_displayVariantComboBox;
    Element *element = displayElement();
    // Filling or re-selecting the current variant must not ask the element
    // to change its display.
    const QSignalBlocker blocker(box);
    if (box->count() == 0) {
        box->addItem(tr("All"));
        if (element) {
            box->addItems(element->displayChildrenVariants());
            box->setEnabled(true);
        } else {
            box->setEnabled(false);
        }
        if (element && element->displayChildrenVariant() >= 0
            && element->displayChildrenVariant() < box->count())
            box->setCurrentIndex(element->displayChildrenVariant());
    } else if (box->count() > 1 && element && element->displayChildrenVariant() >= 0
               && element->displayChildrenVariant() < box->count()) {
        box->setCurrentIndex(element->displayChildrenVariant());
    }
    QDialog::showEvent(event);
}

Element *AbstractChoiceDialog::displayElement() const
{
    if (!_model)
        return nullptr;
    auto *element = dynamic_cast<Element *>(_model->rootNode());
    if (element && (element->availableOperations() & ChangeDisplayOperation))
        return element;
    return nullptr;
}
