// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "serviceelement.h"

#include "kvticons_p.h"
#include "servicelightelementdata.h"

#include <QGuiApplication>

namespace {

// Theme icons need the GUI application; without one (a command-line tool
// using the library) they are null rather than a crash.
bool canLoadThemeIcons()
{
    return qobject_cast<QGuiApplication *>(QCoreApplication::instance()) != nullptr;
}

} // namespace

ServiceElement::ServiceElement(Module &module, RightsPredicate rights)
    : Element(module, rights)
{
    _elementData = new ServiceLightElementData;
}

ServiceElement::~ServiceElement() = default;

QVariant ServiceElement::data(int column, int role) const
{
    if (column == 0 && role == Qt::DecorationRole) {
        const auto *service = dynamic_cast<const ServiceLightElementData *>(_elementData);
        if (service && !service->textState().isEmpty())
            return service->state() ? startIcon() : stopIcon();
    }
    return Element::data(column, role);
}

QIcon ServiceElement::startIcon()
{
    if (!canLoadThemeIcons())
        return QIcon();
    static const QIcon icon = kvtThemeIcon(QStringLiteral("media-playback-start"));
    return icon;
}

QIcon ServiceElement::stopIcon()
{
    if (!canLoadThemeIcons())
        return QIcon();
    static const QIcon icon = kvtThemeIcon(QStringLiteral("media-playback-stop"));
    return icon;
}
