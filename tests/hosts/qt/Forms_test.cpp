#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollArea>
#include <QSpinBox>
#include <QTabWidget>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

using frame::Variant;
using test::ErrorOf;

class FormsTest : public test::QtTest {
  protected:
    template <class Widget>
    Widget* Put(const char* name, QWidget* parent = nullptr) {
        auto* widget = new Widget(parent ? parent : window.data());
        widget->setObjectName(name);
        return widget;
    }
    static std::string Names(const frame::Siblings& siblings) {
        std::vector<std::string> names;
        for (int i = 0; i < siblings.Count(); ++i) {
            names.push_back(const_cast<frame::Siblings&>(siblings).Item(i).Get("Name").ToText());
        }
        return test::Joined(names);
    }
    static frame::Object& Named(QWidget* widget, QWidget* form) {
        Form& all = Form::of(*form);
        for (int i = 0; i < all.Count(); ++i) {
            if (all.Item(i).Get("Name").ToText() == widget->objectName().toStdString()) return all.Item(i);
        }
        throw std::runtime_error("not on the form");
    }
    frame::Object& Named(QWidget* widget) { return Named(widget, window); }
    static Variant Of(frame::Object& object, const char* member) { return object.Get(member); }
};

TEST_F(FormsTest, TheControlsParentIsTheForm) {
    Link* link = Add();
    frame::Object* parent = link->control().Site()->Parent();
    ASSERT_TRUE(parent);
    EXPECT_EQ(parent, &Form::of(*window));
    EXPECT_EQ(Of(*parent, "Name"), Variant("frmMain"));
    EXPECT_EQ(Of(*parent, "ScaleWidth"), Variant(6000.0f));
    EXPECT_EQ(Of(*parent, "ScaleHeight"), Variant(4500.0f));
    window->resize(300, 200);
    EXPECT_EQ(Of(*parent, "ScaleWidth"), Variant(4500.0f));
}

TEST_F(FormsTest, SiblingsAreTheNamedWidgetsInTheOrderOfTheirCreation) {
    Put<QPushButton>("cmdOne");
    Link* link = Add("lnkTwo");
    auto* group = Put<QGroupBox>("grpThree");
    Put<QLineEdit>("txtFour", group);
    Put<QLabel>("labFive");
    new QLabel("no name", window);
    EXPECT_EQ(Names(link->control().Site()->ParentControls()), "cmdOne lnkTwo grpThree txtFour labFive");
}

TEST_F(FormsTest, RaisingAWidgetDoesNotChangeTheOrder) {
    auto* one = Put<QPushButton>("one");
    Put<QPushButton>("two");
    Form& form = Form::of(*window);
    EXPECT_EQ(Names(form), "one two");
    one->raise();
    EXPECT_EQ(Names(form), "one two");
    Put<QPushButton>("three");
    one->raise();
    EXPECT_EQ(Names(form), "one two three");
}

TEST_F(FormsTest, InnerPartsAreNoMembers) {
    Put<QSpinBox>("spin");
    Put<QScrollArea>("scroll")->setWidget(new QLabel("inside"));
    Put<QLineEdit>("edit")->setClearButtonEnabled(true);
    Link* link = Add("lnk");
    Show();
    EXPECT_EQ(Names(link->control().Site()->ParentControls()), "spin scroll edit lnk");
}

TEST_F(FormsTest, WhatStandsInsideContainersIsAMember) {
    auto* tabs = Put<QTabWidget>("tabs");
    auto* page = new QWidget;
    page->setObjectName("page");
    tabs->addTab(page, "Page");
    Put<QCheckBox>("check", page);
    auto* scroll = Put<QScrollArea>("scroll");
    auto* inside = new QLabel("inside");
    inside->setObjectName("inside");
    scroll->setWidget(inside);
    const std::string names = Names(Form::of(*window));
    for (const char* name : {"tabs", "page", "check", "scroll", "inside"}) EXPECT_THAT(names, testing::HasSubstr(name));
}

TEST_F(FormsTest, AFormOnAFormHasItsOwnMembers) {
    auto* inner = Put<QWidget>("frmInner");
    Host::setForm(inner);
    Link outer(window);
    outer.setObjectName("outer");
    Link within(inner);
    within.setObjectName("within");
    EXPECT_EQ(Names(within.control().Site()->ParentControls()), "within");
    EXPECT_EQ(Of(*within.control().Site()->Parent(), "Name"), Variant("frmInner"));
    EXPECT_EQ(Names(outer.control().Site()->ParentControls()).find("within"), std::string::npos);
}

TEST_F(FormsTest, ADialogOfTheFormIsNoMember) {
    auto* dialog = new QWidget(window, Qt::Dialog);
    dialog->setObjectName("dialog");
    Put<QLabel>("onDialog", dialog);
    Put<QLabel>("onForm");
    EXPECT_EQ(Names(Form::of(*window)), "onForm");
}

TEST_F(FormsTest, AWidgetThatGoesLeavesTheForm) {
    auto* one = Put<QPushButton>("one");
    Put<QPushButton>("two");
    Form& form = Form::of(*window);
    EXPECT_EQ(form.Count(), 2);
    delete one;
    EXPECT_EQ(Names(form), "two");
}

TEST_F(FormsTest, AWidgetThatMovesToAnotherFormLeavesTheFirst) {
    QWidget other;
    auto* one = Put<QPushButton>("one");
    Form& form = Form::of(*window);
    EXPECT_EQ(form.Count(), 1);
    one->setParent(&other);
    EXPECT_EQ(form.Count(), 0);
    EXPECT_EQ(Names(Form::of(other)), "one");
}

TEST_F(FormsTest, AnIndexOutsideIsError9) {
    Put<QPushButton>("one");
    Form& form = Form::of(*window);
    EXPECT_EQ(ErrorOf([&] { form.Item(-1); }), 9);
    EXPECT_EQ(ErrorOf([&] { form.Item(1); }), 9);
    EXPECT_EQ(ErrorOf([&] { form.Item(0); }), 0);
}

TEST_F(FormsTest, TheFormIsOneAndGoesWithItsWidget) {
    auto* widget = new QWidget;
    Form* form = &Form::of(*widget);
    EXPECT_EQ(form, &Form::of(*widget));
    const QPointer<Form> watch(form);
    const frame::ObjectRef reference(static_cast<frame::Object&>(*form));
    delete widget;
    EXPECT_FALSE(watch);
    EXPECT_EQ(reference.Get(), nullptr);
}

TEST_F(FormsTest, AControlIsMetAsItsExtender) {
    Link* link = Add("lnk");
    frame::Object& met = Named(link);
    EXPECT_EQ(&met, &link->extender());
    met.Put("Caption", Variant("set by a sibling"));
    EXPECT_EQ(link->caption(), "set by a sibling");
    met.Put("Left", Variant(300));
    met.Put("visible", Variant(false));
    EXPECT_EQ(link->x(), 20);
    EXPECT_TRUE(link->isHidden());
    EXPECT_EQ(Of(met, "Visible"), Variant(false));
    met.Put("HighlightColor", Variant(frame::OLE_COLOR(0xFF)));
    EXPECT_EQ(link->highlightColor(), QColor(Qt::red));
    link->setProperty("Index", 3);
    EXPECT_EQ(Of(met, "Index"), Variant(3));
}

TEST_F(FormsTest, ALinkWithoutAnIndexHasNone) {
    Link* link = Add("lnk");
    EXPECT_EQ(ErrorOf([&] { link->extender().Get("Index"); }), 438);
    EXPECT_FALSE(link->extender().Has("Index"));
    EXPECT_TRUE(link->extender().Has("ToolTipText"));
    EXPECT_TRUE(link->extender().Has("caption"));
    EXPECT_TRUE(link->extender().Has("LEFT"));
}

TEST_F(FormsTest, ANumberIsAlwaysAMemberOfTheControl) {
    frame::Object& extender = Add("lnk")->extender();
    EXPECT_TRUE(extender.Has(frame::dispatch::caption));
    EXPECT_TRUE(extender.Has(1));
    EXPECT_EQ(extender.Get(1), extender.Get("BackColor"));
    EXPECT_FALSE(extender.Has(1000));
}

TEST_F(FormsTest, TheNameOfAControlIsReadOnlyForSiblings) {
    Link* link = Add("lnk");
    EXPECT_NE(ErrorOf([&] { link->extender().Put("Name", Variant("other")); }), 0);
    EXPECT_EQ(link->objectName(), "lnk");
}

TEST_F(FormsTest, AnExtenderReachedAfterItsLinkHasGoneIsError91OrNothing) {
    Link* link = Add("lnk");
    const frame::ObjectRef reference(link->extender());
    delete link;
    test::Settle();
    EXPECT_EQ(reference.Get(), nullptr);
    EXPECT_EQ(ErrorOf([&] { reference->Get("Name"); }), 91);
}

TEST_F(FormsTest, SiblingsMayBeAskedWhileAFocusedLinkGoes) {
    Put<QPushButton>("cmd")->setGeometry(200, 200, 80, 30);
    Link* link = Shown("lnk");
    link->setFocus(Qt::TabFocusReason);
    Form& form = Form::of(*window);
    EXPECT_EQ(form.Count(), 2);
    int asked = 0;
    const auto ask = [&] {
        ++asked;
        for (int i = 0; i < form.Count(); ++i) {
            const int error = ErrorOf([&] { form.Item(i).Get("Name"); });
            EXPECT_TRUE(error == 0 || error == 91) << error;
        }
    };
    const auto focus = QObject::connect(qApp, &QApplication::focusChanged, ask);
    QObject::connect(link, &QObject::destroyed, ask);
    delete link;
    QObject::disconnect(focus);
    EXPECT_GT(asked, 0);
    EXPECT_EQ(Names(form), "cmd");
}

TEST_F(FormsTest, ALinkThatIsRenamedToNothingLeavesTheForm) {
    Link* link = Add("lnk");
    Form& form = Form::of(*window);
    EXPECT_EQ(form.Count(), 1);
    link->setObjectName("");
    EXPECT_EQ(form.Count(), 0);
    link->setObjectName("again");
    EXPECT_EQ(Names(form), "again");
}

// Other widgets.

TEST_F(FormsTest, GeometryIsInTwipsAndStaysAsItWasSet) {
    auto* button = Put<QPushButton>("cmd");
    button->setGeometry(10, 20, 100, 30);
    frame::Object& object = Named(button);
    EXPECT_EQ(Of(object, "Left"), Variant(150));
    EXPECT_EQ(Of(object, "Top"), Variant(300));
    EXPECT_EQ(Of(object, "Width"), Variant(1500));
    EXPECT_EQ(Of(object, "Height"), Variant(450));
    object.Put("Width", Variant(1664.53f));
    object.Put("Left", Variant(157.5f));
    EXPECT_EQ(Of(object, "Width"), Variant(1664.53f));
    EXPECT_EQ(Of(object, "Left"), Variant(157.5f));
    EXPECT_EQ(Of(object, "Height"), Variant(450));
    EXPECT_EQ(button->y(), 20);
    button->resize(50, 30);
    EXPECT_EQ(Of(object, "Width"), Variant(750));
    EXPECT_EQ(Of(object, "Left"), Variant(157.5f));
}

TEST_F(FormsTest, NeighboursThatAreMovedInTwipsStayNeighbours) {
    auto* one = Put<QPushButton>("one");
    auto* two = Put<QPushButton>("two");
    for (float left = 0; left < 60; left += 3.7f) {
        frame::Object& first = Named(one);
        frame::Object& second = Named(two);
        first.Put("Left", Variant(left));
        first.Put("Width", Variant(1502.3f));
        second.Put("Left", Variant(left + 1502.3f));
        EXPECT_EQ(one->x() + one->width(), two->x()) << left;
    }
}

TEST_F(FormsTest, ANegativeExtentDoesNoHarm) {
    auto* button = Put<QPushButton>("cmd");
    Named(button).Put("Width", Variant(-1500));
    EXPECT_GE(button->width(), 0);
}

TEST_F(FormsTest, SiblingsAreRestyled) {
    auto* label = Put<QLabel>("lab");
    frame::Object& object = Named(label);
    object.Put("BackColor", Variant(frame::OLE_COLOR(0x00FF00)));
    object.Put("ForeColor", Variant(frame::OLE_COLOR(0x0000FF)));
    object.Put("Font", Variant(std::make_shared<frame::Font>("DejaVu Serif", 24)));
    object.Put("Caption", Variant("Text"));
    object.Put("ToolTipText", Variant("Tip"));
    object.Put("Enabled", Variant(false));
    EXPECT_EQ(label->text(), "Text");
    EXPECT_EQ(label->toolTip(), "Tip");
    EXPECT_FALSE(label->isEnabled());
    EXPECT_EQ(label->font().family(), "DejaVu Serif");
    EXPECT_EQ(QFontInfo(label->font()).pixelSize(), 32);
    EXPECT_EQ(label->palette().color(label->foregroundRole()), QColor(Qt::red));
    label->setEnabled(true);
    label->resize(100, 50);
    const QImage seen = label->grab().toImage();
    EXPECT_EQ(seen.pixelColor(seen.width() - 1, 0), QColor(Qt::green));
    EXPECT_EQ(Of(object, "BackColor").ToColor(), frame::OLE_COLOR(0x00FF00));
    EXPECT_EQ(Of(object, "ForeColor").ToColor(), frame::OLE_COLOR(0x0000FF));
    EXPECT_EQ(Of(object, "Text"), Variant("Text"));
}

TEST_F(FormsTest, TheCaptionOfAGroupIsItsTitle) {
    auto* group = Put<QGroupBox>("grp");
    auto* inside = Put<QLabel>("inside", group);
    Named(group).Put("Caption", Variant("Title"));
    EXPECT_EQ(group->title(), "Title");
    EXPECT_EQ(Of(Named(inside), "Caption"), Variant(""));
}

TEST_F(FormsTest, NoFontLetsAWidgetFollowItsParentAgain) {
    auto* label = Put<QLabel>("lab");
    const QString before = label->font().family();
    Named(label).Put("Font", Variant(std::make_shared<frame::Font>("DejaVu Serif", 24)));
    EXPECT_NE(label->font().family(), before);
    Named(label).Put("Font", Variant(frame::ObjectRef()));
    EXPECT_EQ(label->font().family(), before);
}

TEST_F(FormsTest, EveryPropertyOfAWidgetIsReachedWithoutRegardToCase) {
    auto* box = Put<QSpinBox>("spin");
    frame::Object& object = Named(box);
    object.Put("MAXIMUM", Variant(500));
    object.Put("Value", Variant(400));
    EXPECT_EQ(box->value(), 400);
    EXPECT_EQ(Of(object, "value"), Variant(400));
    EXPECT_TRUE(object.Has("SingleStep"));
    auto* check = Put<QCheckBox>("chk");
    Named(check).Put("Checked", Variant(-1));
    EXPECT_TRUE(check->isChecked());
}

TEST_F(FormsTest, MissingNamesAreError438) {
    auto* button = Put<QPushButton>("cmd");
    frame::Object& object = Named(button);
    EXPECT_EQ(ErrorOf([&] { object.Get("NoSuchMember"); }), 438);
    EXPECT_EQ(ErrorOf([&] { object.Put("NoSuchMember", Variant(1)); }), 438);
    EXPECT_EQ(ErrorOf([&] { object.Get("Index"); }), 438);
    EXPECT_EQ(ErrorOf([&] { object.Get(""); }), 438);
    EXPECT_EQ(ErrorOf([&] { object.Get(-518); }), 438);
    EXPECT_TRUE(button->dynamicPropertyNames().isEmpty());
    EXPECT_FALSE(object.Has("NoSuchMember"));
    button->setProperty("Index", 5);
    EXPECT_EQ(Of(object, "index"), Variant(5));
}

TEST_F(FormsTest, AValueThatDoesNotConvertIsAnErrorAndChangesNothing) {
    auto* box = Put<QSpinBox>("spin");
    frame::Object& object = Named(box);
    EXPECT_EQ(ErrorOf([&] { object.Put("Value", Variant("many")); }), 13);
    EXPECT_EQ(box->value(), 0);
    EXPECT_EQ(ErrorOf([&] { object.Put("Left", Variant("far")); }), 13);
    EXPECT_EQ(ErrorOf([&] { object.Put("Name", Variant("x")); }), 382);
}

TEST_F(FormsTest, AWidgetThatHasGoneIsError91) {
    auto* button = new QPushButton(window);
    WidgetObject object(*button);
    delete button;
    EXPECT_EQ(object.widget(), nullptr);
    for (const char* member : {"Name", "Left", "Caption", "BackColor", "NoSuchMember"}) {
        EXPECT_EQ(ErrorOf([&] { object.Get(member); }), 91) << member;
    }
    EXPECT_EQ(ErrorOf([&] { object.Put("Left", Variant(1)); }), 91);
    EXPECT_EQ(ErrorOf([&] { object.Put("Caption", Variant("x")); }), 91);
    EXPECT_FALSE(object.Has("Caption"));
    EXPECT_EQ(object.Path(), "");
}

TEST_F(FormsTest, AWidgetDisabledByItsFormIsNotDisabledItself) {
    auto* button = Put<QPushButton>("cmd");
    window->setEnabled(false);
    EXPECT_EQ(Of(Named(button), "Enabled"), Variant(true));
    EXPECT_EQ(Of(Named(button), "Visible"), Variant(true));
    button->hide();
    EXPECT_EQ(Of(Named(button), "Visible"), Variant(false));
}

TEST_F(FormsTest, TheFormItselfIsRestyled) {
    frame::Object& form = Form::of(*window);
    form.Put("Caption", Variant("Title"));
    EXPECT_EQ(window->windowTitle(), "Title");
    form.Put("BackColor", Variant(frame::OLE_COLOR(0x123456)));
    EXPECT_EQ(window->grab().toImage().pixelColor(5, 5), QColor(0x56, 0x34, 0x12));
}

TEST_F(FormsTest, AFormRestyledAgainAndAgainShowsBehindItsLinks) {
    Link* link = Shown();
    for (const std::uint32_t color : {0x0000FFu, 0x00FF00u, 0xFFFFFFu}) {
        Form::of(*window).Put("BackColor", Variant(frame::OLE_COLOR(color)));
        test::Settle();
        const QImage seen = window->grab().toImage();
        EXPECT_EQ(seen.pixelColor(link->geometry().bottomRight()), seen.pixelColor(5, 5)) << color;
    }
}

}  // namespace
}  // namespace tessel::qt
