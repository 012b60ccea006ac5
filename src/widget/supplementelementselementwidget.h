#ifndef KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H
#define KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H

#include "elementselementwidget.h"

/*!
 * The list of ElementsElementWidget offered as a supplement tab for any
 * element type: its supplement type is ContextOperation::allElementType,
 * its priority 750 (after the element's own widget), and its window title,
 * the tab's title, is \a title.
 */
class KVTCOMMON_EXPORT SupplementElementsElementWidget : public ElementsElementWidget
{
    Q_OBJECT

public:
    SupplementElementsElementWidget(const QString &type, const QString &title, Module &module,
                                    RightsPredicate check, QWidget *parent = nullptr);
    ~SupplementElementsElementWidget() override;
};

#endif // KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H
