#include "controls/folderview/FolderView.h"

#include <array>

#include "fileservices/DesignImages.h"
#include "fileservices/SpecialFolders.h"
#include "frame/ResumeNext.h"

namespace tessel::controls {

using child::Timer;
using child::TreeNodeRef;
using child::TreeView;
using frame::OLE_COLOR;
using frame::ResumeNext;
using frame::VarType;

namespace {
constexpr frame::TextSize designSize{3600, 3600};
}

FolderView::FolderView(frame::Host& host) : Control(host) {
    DesignPictures();
    DesignTree();
    Connect();
}

void FolderView::DesignPictures() {
    constexpr OLE_COLOR mask = 0xC0C0C0;
    constexpr int side = 16;
    namespace designed = fileservices::designimages;
    Image16.SetMaskColor(mask);
    for (const auto key : {designed::myComputer, designed::myFolders, designed::driveUnavailable, designed::folderUnavailable})
        Image16.ListImages.Add({}, std::string(key), designed::Draw(key, side));
    TempPic.SetVisible(false);
    TempPic.SetBorderStyle(0);
    TempPic.SetBackColor(mask);  // what an icon leaves free is clear in the list
}

void FolderView::DesignTree() {
    TreeFolders.Move(0, 0, designSize.width, designSize.height);
    TreeFolders.SetForeColor(frame::colors::buttonText);
    TreeFolders.SetImageList(&Image16);
    TreeFolders.SetHideSelection(false);  // the current folder is to be seen wherever the user works
}

void FolderView::Connect() {
    TreeFolders.Click.To<&FolderView::TreeClick>(*this);
    TreeFolders.DblClick.To<&FolderView::TreeDblClick>(*this);
    TreeFolders.KeyDown.To<&FolderView::TreeKeyDown>(*this);
    TreeFolders.KeyPress.To<&FolderView::TreeKeyPress>(*this);
    TreeFolders.KeyUp.To<&FolderView::TreeKeyUp>(*this);
    TreeFolders.MouseDown.To<&FolderView::TreeMouseDown>(*this);
    TreeFolders.MouseMove.To<&FolderView::TreeMouseMove>(*this);
    TreeFolders.MouseUp.To<&FolderView::TreeMouseUp>(*this);
    TreeFolders.NodeClick.To<&FolderView::TreeNodeClick>(*this);
    TreeFolders.Expand.To<&FolderView::TreeExpand>(*this);
    TreeFolders.Collapse.To<&FolderView::TreeCollapse>(*this);
    RefreshTimer.Elapsed.To<&FolderView::TimerElapsed>(*this);
}

template <auto Set, class T>
void FolderView::SetStock(std::string_view key, const T& value) {
    (TreeFolders.*Set)(value);
    PropertyChanged(key);
}

void FolderView::SetForeColor(OLE_COLOR value) { SetStock<&TreeView::SetForeColor>("ForeColor", value); }
void FolderView::SetEnabled(bool value) { SetStock<&TreeView::SetEnabled>("Enabled", value); }
void FolderView::SetFont(const frame::FontRef& value) { SetStock<&TreeView::SetFont>("Font", value); }
void FolderView::SetBorderStyle(child::TreeBorderConstants value) { SetStock<&TreeView::SetBorderStyle>("BorderStyle", value); }
void FolderView::SetAppearance(child::AppearanceConstants value) { SetStock<&TreeView::SetAppearance>("Appearance", value); }
void FolderView::SetMousePointer(std::int16_t value) { SetStock<&TreeView::SetMousePointer>("MousePointer", value); }
void FolderView::SetMouseIcon(const frame::PictureRef& value) { SetStock<&TreeView::SetMouseIcon>("MouseIcon", value); }
void FolderView::SetFullRowSelect(bool value) { SetStock<&TreeView::SetFullRowSelect>("FullRowSelect", value); }
void FolderView::SetHotTracking(bool value) { SetStock<&TreeView::SetHotTracking>("HotTracking", value); }

void FolderView::SetPathRoot(const std::string& value) {
    own.PathRoot = value;
    RebuildTree();
    PropertyChanged("PathRoot");
}

void FolderView::SetAutoFillSubFolders(bool value) {
    own.AutoFillSubFolders = value;
    PropertyChanged("AutoFillSubFolders");
}

void FolderView::SetAllowHiddenFolders(bool value) {
    own.AllowHiddenFolders = value;
    PropertyChanged("AllowHiddenFolders");
}

void FolderView::SetAllowSystemFolders(bool value) {
    own.AllowSystemFolders = value;
    PropertyChanged("AllowSystemFolders");
}

void FolderView::SetAllowLabelEdit(bool value) {
    own.AllowLabelEdit = value;
    TreeFolders.SetLabelEdit(value ? child::TreeLabelEditConstants::Manual : child::TreeLabelEditConstants::Automatic);
    PropertyChanged("AllowLabelEdit");
}

void FolderView::SetOLEDragMode(child::OLEDragConstants value) {
    own.OLEDragMode = value;
    PropertyChanged("OLEDragMode");
}

void FolderView::SetOLEDropMode(child::OLEDropConstants value) {
    own.OLEDropMode = value;
    PropertyChanged("OLEDropMode");
}

void FolderView::SetRefreshInterval(std::int32_t value) {
    RefreshTimer.SetInterval(value);
    PropertyChanged("RefreshInterval");
}

// Life.

void FolderView::Initialize() { own.PersonalPath = Host().Module<fileservices::SpecialFolders>().SpecialFolderPath("Personal"); }

void FolderView::Resize() {
    TreeFolders.SetWidth(Surface().ScaleWidth());
    TreeFolders.SetHeight(Surface().ScaleHeight());
}

void FolderView::Show() { RebuildTree(); }

frame::TextSize FolderView::DesignSize() const { return designSize; }

// What the tree reports.

void FolderView::TreeClick() { ForwardEvent(frame::stock::Click); }
void FolderView::TreeDblClick() { ForwardEvent(frame::stock::DblClick); }
void FolderView::TreeKeyDown(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyDown, keyCode, shift); }
void FolderView::TreeKeyPress(std::int16_t keyAscii) { ForwardEvent(frame::stock::KeyPress, keyAscii); }
void FolderView::TreeKeyUp(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyUp, keyCode, shift); }

/// A press is a click on the node already; the tree's own click comes as a second one. The right button selects the node too.
void FolderView::TreeMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
    constexpr std::int16_t rightButton = 2;
    ForwardEvent(frame::stock::MouseDown, button, shift, x, y);
    if (!Site()) return;
    const TreeNodeRef node = TreeFolders.HitTest(x, y);
    if (button != rightButton)
        own.MouseIsDown = true;
    else if (node)
        Tree().SetSelected(node->Ref().node);
    if (node) ClickNode(node);
}

/// The selection follows the pointer while a button is down.
void FolderView::TreeMouseMove(std::int16_t button, std::int16_t shift, float x, float y) {
    if (x == own.MouseX && y == own.MouseY) return;
    own.MouseX = x;
    own.MouseY = y;
    ForwardEvent(frame::stock::MouseMove, button, shift, x, y);
    if (!Site() || !own.MouseIsDown) return;
    const TreeNodeRef node = TreeFolders.HitTest(x, y);
    if (!node) return;
    Tree().SetSelected(node->Ref().node);
    ReportPathChange(node->Ref());
}

void FolderView::TreeMouseUp(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseUp, button, shift, x, y);
    ResetMouseState();
}

void FolderView::ResetMouseState() { own.MouseIsDown = false; }

void FolderView::TreeNodeClick(const TreeNodeRef& node) { ClickNode(node); }

void FolderView::TreeExpand(const TreeNodeRef& node) {
    ResumeNext next;
    next([&] { ForwardEvent(folderview::Expand, node); });
    if (Site()) ExpandNode(node->Ref());
}

void FolderView::TreeCollapse(const TreeNodeRef& node) { ForwardEvent(folderview::Collapse, node); }

// Tables.

namespace {

/// A key that lives in `TreeFolders`.
template <auto Get, auto Set, class... Default>
constexpr frame::BagKey OfTree(std::string_view name, Default... otherwise) {
    return frame::childKey<&FolderView::TreeFolders, Get, Set>(name, otherwise...);
}

}  // namespace

struct FolderView::Tables {
    static constexpr std::array members = {
        frame::property<&FolderView::Enabled, &FolderView::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events.",
            frame::dispatch::enabled),
        frame::property<&FolderView::Font, &FolderView::SetFont>("Font", "Returns a Font object.", frame::dispatch::font),
        frame::property<&FolderView::BorderStyle, &FolderView::SetBorderStyle>(
            "BorderStyle", "Returns/sets the border style for an object.", frame::dispatch::borderStyle),
        frame::property<&FolderView::Appearance, &FolderView::SetAppearance>(
            "Appearance", "Returns/sets whether or not an object is painted with 3-D effects.", frame::dispatch::appearance),
        frame::property<&FolderView::MousePointer, &FolderView::SetMousePointer>(
            "MousePointer", "Returns/sets the type of mouse pointer displayed over the tree."),
        frame::property<&FolderView::MouseIcon, &FolderView::SetMouseIcon>("MouseIcon", "Sets a custom mouse icon."),
        frame::property<&FolderView::ForeColor, &FolderView::SetForeColor>(
            "ForeColor", "Returns/sets the foreground color used to display text and graphics in an object.",
            frame::dispatch::foreColor),
        frame::property<&FolderView::BackColor>("BackColor",
                                                "Returns the background color used to display text and graphics in an object.",
                                                frame::dispatch::backColor),
        frame::property<&FolderView::FullRowSelect, &FolderView::SetFullRowSelect>(
            "FullRowSelect",
            "Returns/sets a value which determines if the entire row of the selected item is highlighted and clicking anywhere on "
            "an item's row causes it to be selected."),
        frame::property<&FolderView::HotTracking, &FolderView::SetHotTracking>(
            "HotTracking", "Returns/sets a value which determines if items are highlighted as the mousepointer passes over them."),
        frame::property<&FolderView::PathRoot, &FolderView::SetPathRoot>(
            "PathRoot",
            "Shows or sets the root path for the control.  Used to initialise the control.  Special folders are 'My Computer', "
            "'My Documents' and 'My Folders'."),
        frame::property<&FolderView::OLEDropMode, &FolderView::SetOLEDropMode>(
            "OLEDropMode", "Returns/Sets whether this control can act as an OLE drop target."),
        frame::property<&FolderView::OLEDragMode, &FolderView::SetOLEDragMode>(
            "OLEDragMode",
            "Returns/Sets whether this control can act as an OLE drag/drop source, and whether this process is started "
            "automatically or under programmatic control."),
        frame::property<&FolderView::AllowLabelEdit, &FolderView::SetAllowLabelEdit>(
            "AllowLabelEdit", "If set TRUE allows the user to edit folder names."),
        frame::property<&FolderView::AllowHiddenFolders, &FolderView::SetAllowHiddenFolders>(
            "AllowHiddenFolders", "When set true, hidden folders are shown as well as normal folders"),
        frame::property<&FolderView::AllowSystemFolders, &FolderView::SetAllowSystemFolders>(
            "AllowSystemFolders", "When set true, system folders are shown as well as normal folders"),
        frame::readOnlyProperty<&FolderView::ImageCount>("ImageCount", "Count of the number of images in the list"),
        frame::runTimeProperty<&FolderView::ImageIndex, &FolderView::SetImageIndex>(
            "ImageIndex", "Index to the current image used for programming"),
        frame::runTimeProperty<&FolderView::ImageTag, &FolderView::SetImageTag>("ImageTag",
                                                                                "Tag for the current (ImageIndex) image."),
        frame::runTimeProperty<&FolderView::ImageKey, &FolderView::SetImageKey>("ImageKey",
                                                                                "Key of the current image (using ImageIndex)"),
        frame::property<&FolderView::RefreshInterval, &FolderView::SetRefreshInterval>(
            "RefreshInterval",
            "Returns/sets the number of milliseconds between automatic refreshes.  0 is none. 1000 is 1 second."),
        frame::runTimeProperty<&FolderView::ItemIndex, &FolderView::SetItemIndex>(
            "ItemIndex", "Returns or sets the index to the folder items (used in programming)"),
        frame::runTimeProperty<&FolderView::ItemTag, &FolderView::SetItemTag>("ItemTag",
                                                                              "Tag associated with each folder item displayed"),
        frame::runTimeProperty<&FolderView::ItemExpanded, &FolderView::SetItemExpanded>(
            "ItemExpanded", "Returns true if the item referenced by ItemIndex is expanded, false otherwise."),
        frame::runTimeProperty<&FolderView::ItemIcon, &FolderView::SetItemIcon>(
            "ItemIcon", "Returns or sets the folder items icon image by key (see ImageKey)"),
        frame::readOnlyProperty<&FolderView::ItemCount>("ItemCount", "Returns the number of folder items in the list."),
        frame::runTimeProperty<&FolderView::ItemName, &FolderView::SetItemName>(
            "ItemName", "Returns the real name of the item referenced by ItemIndex (normally the same as DisplayName)."),
        frame::runTimeProperty<&FolderView::ItemDisplayName, &FolderView::SetItemDisplayName>(
            "ItemDisplayName", "Returns the display name of the item referenced by ItemIndex."),
        frame::runTimeProperty<&FolderView::ItemSelected, &FolderView::SetItemSelected>(
            "ItemSelected",
            "Returns TRUE if the item referenced by ItemIndex is selected, FALSE if not.  Setting to TRUE changes the selected "
            "item."),
        frame::readOnlyProperty<&FolderView::ItemPath>("ItemPath", "Returns the full path of the item referenced by ItemIndex."),
        frame::runTimeProperty<&FolderView::FolderPath, &FolderView::SetFolderPath>(
            "Path", "Shows the current path of the current folder selected."),
        frame::runTimeProperty<&FolderView::SelectedItem, &FolderView::SetSelectedItem>(
            "SelectedItem", "Sets and returns the index of the currently selected item"),
        frame::property<&FolderView::AutoFillSubFolders, &FolderView::SetAutoFillSubFolders>(
            "AutoFillSubFolders", "Automatically fill in sub-folders (creates the + symbol if sub-folders exist but is slower)."),
        frame::method<&FolderView::Refresh>("Refresh", "Makes the tree true to the disk.", {}, frame::dispatch::refresh),
        frame::method<&FolderView::GoUp>("GoUp", "Selects the folder above."),
        frame::method<&FolderView::GetMyFolders>("GetMyFolders", "Gets the special string list for My Folders."),
        frame::method<&FolderView::ImageAddNew>("ImageAddNew", "Adds a new image to the list of images", {"MyImage", "MyKey"}),
        frame::method<&FolderView::ImageRemove>("ImageRemove", "Removes the current (ImageIndex) image from the list of images",
                                                {"MyKey"}),
        // 39 is OLEDrag; 41 to 45 are Cut, Copy, Paste, Delete and Properties.
        frame::method<&FolderView::AddNewFolder>(
            "AddNewFolder", "Adds a new folder (if the special folder 'My Folders' is selected it create a new virtual folder.",
            {"NewFolderName"}, 40),
    };
    static constexpr std::array<const frame::EventInfo*, 27> events = {
        &folderview::AfterDelete,     &folderview::BeforeDelete,  &folderview::BeforeLabelEdit, &folderview::AfterLabelEdit,
        &folderview::OLECompleteDrag, &folderview::OLEDragDrop,   &folderview::OLEDragOver,     &folderview::OLEGiveFeedback,
        &folderview::OLESetData,      &folderview::OLEStartDrag,  &folderview::Collapse,        &folderview::Expand,
        &folderview::NodeClick,       &folderview::BeforePaint,   &folderview::AfterPaint,      &folderview::AfterAddItem,
        &folderview::BeforeAddItem,   &folderview::ChangedFolder, &folderview::BeforePopup,     &frame::stock::Click,
        &frame::stock::DblClick,      &frame::stock::KeyDown,     &frame::stock::KeyPress,      &frame::stock::KeyUp,
        &frame::stock::MouseDown,     &frame::stock::MouseMove,   &frame::stock::MouseUp,
    };
    static constexpr std::array kept = {
        OfTree<&TreeView::Enabled, &TreeView::SetEnabled>("Enabled", VarType::Boolean, true),
        OfTree<&TreeView::Font, &TreeView::SetFont>("Font", frame::ambientFont),
        OfTree<&TreeView::BorderStyle, &TreeView::SetBorderStyle>("BorderStyle", VarType::Integer, 0),
        OfTree<&TreeView::Appearance, &TreeView::SetAppearance>("Appearance", VarType::Integer, 1),
        OfTree<&TreeView::FullRowSelect, &TreeView::SetFullRowSelect>("FullRowSelect", VarType::Boolean, false),
        OfTree<&TreeView::HotTracking, &TreeView::SetHotTracking>("HotTracking", VarType::Boolean, false),
        OfTree<&TreeView::LabelEdit, &TreeView::SetLabelEdit>("LabelEdit", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::OLEDropMode>("OLEDropMode", VarType::Long, 2),
        frame::key<&FolderView::own, &Own::OLEDragMode>("OLEDragMode", VarType::Long, 1),
        frame::key<&FolderView::own, &Own::AllowLabelEdit>("AllowLabelEdit", VarType::Boolean, true),
        frame::key<&FolderView::own, &Own::PathRoot>("PathRoot", ""),
        frame::key<&FolderView::own, &Own::AllowHiddenFolders>("AllowHiddenFolders", VarType::Boolean, false),
        frame::key<&FolderView::own, &Own::AllowSystemFolders>("AllowSystemFolders", VarType::Boolean, false),
        OfTree<&TreeView::ForeColor, &TreeView::SetForeColor>("ForeColor", VarType::Long, 0x80000012),
        frame::key<&FolderView::own, &Own::ImageCount>("ImageCount", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::ImageIndex>("ImageIndex", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::ImageTag>("ImageTag", ""),
        frame::key<&FolderView::own, &Own::ImageKey>("ImageKey", ""),
        frame::childKey<&FolderView::RefreshTimer, &Timer::Interval, &Timer::SetInterval>("RefreshInterval", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::ItemIndex>("ItemIndex", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::ItemTag>("ItemTag", ""),
        frame::key<&FolderView::own, &Own::ItemExpanded>("ItemExpanded", VarType::Boolean, false),
        frame::key<&FolderView::own, &Own::ItemIcon>("ItemIcon", ""),
        frame::key<&FolderView::own, &Own::ItemCount>("ItemCount", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::Path>("Path", ""),
        frame::key<&FolderView::own, &Own::ItemName>("ItemName", ""),
        frame::key<&FolderView::own, &Own::ItemDisplayName>("ItemDisplayName", ""),
        frame::key<&FolderView::own, &Own::ItemSelected>("ItemSelected", VarType::Boolean, false),
        frame::key<&FolderView::own, &Own::ItemPath>("ItemPath", ""),
        OfTree<&TreeView::MousePointer, &TreeView::SetMousePointer>("MousePointer", VarType::Integer, 0),
        OfTree<&TreeView::MouseIcon, &TreeView::SetMouseIcon>("MouseIcon", frame::noObject),
        frame::key<&FolderView::own, &Own::SelectedItem>("SelectedItem", VarType::Integer, 0),
        frame::key<&FolderView::own, &Own::AutoFillSubFolders>("AutoFillSubFolders", VarType::Boolean, false),
    };
    static constexpr std::array parts = {
        frame::part<&FolderView::TreeFolders>("TreeFolders"),
        frame::part<&FolderView::Image16>("Image16"),
        frame::part<&FolderView::TempPic>("TempPic"),
        frame::part<&FolderView::RefreshTimer>("RefreshTimer"),
    };
};

constexpr frame::ClassTable FolderView::table{
    .name = "FolderView", .members = Tables::members, .events = Tables::events, .bag = Tables::kept, .parts = Tables::parts};

}  // namespace tessel::controls
