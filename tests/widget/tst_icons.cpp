// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/choicewidget.h>
#include <kvt-common/serviceelement.h>

#include <QAbstractButton>
#include <QIcon>
#include <QImage>
#include <QTemporaryDir>
#include <QtTest>

namespace {

// Whether the icon draws something at 16 pixels: not null, not transparent.
bool drawsSomething(const QIcon &icon)
{
    const QImage image = icon.pixmap(16, 16).toImage().convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            if (qAlpha(image.pixel(x, y)) > 0)
                return true;
    return false;
}

} // namespace

// On a desktop whose icon theme has none of the icons the library names,
// every one of them still shows an image: the library's own copy.
class IconsTest : public QObject
{
    Q_OBJECT

    QTemporaryDir emptyThemes;

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(emptyThemes.isValid());
        QIcon::setThemeSearchPaths({emptyThemes.path()});
        QIcon::setThemeName(QStringLiteral("no-such-theme"));
    }

    void namedIcons_data()
    {
        QTest::addColumn<QString>("name");
        for (const char *name : {"media-playback-start", "media-playback-stop", "task-ongoing", "task-attention",
                                 "task-complete", "task-reject", "list-add", "list-remove", "process-stop",
                                 "download", "edit-copy"})
            QTest::newRow(name) << QString::fromLatin1(name);
    }
    // Looked up by name, as forms and host applications do.
    void namedIcons()
    {
        QFETCH(QString, name);
        QVERIFY(drawsSomething(QIcon::fromTheme(name)));
    }

    // Looked up by the library's own classes.
    void libraryIcons()
    {
        QVERIFY(drawsSomething(ServiceElement::startIcon()));
        QVERIFY(drawsSomething(ServiceElement::stopIcon()));
        ChoiceWidget choice;
        for (const char *button : {"_addPushButton", "_removePushButton"})
            QVERIFY2(drawsSomething(choice.findChild<QAbstractButton *>(QLatin1String(button))->icon()), button);
        QVERIFY(QIcon::fromTheme(QStringLiteral("no-such-icon")).isNull());
    }
};

QTEST_MAIN(IconsTest)
#include "tst_icons.moc"
