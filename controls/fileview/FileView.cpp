#include "controls/fileview/FileView.h"

#include <array>

#include "fileservices/DesignImages.h"
#include "fileservices/PathHelpers.h"
#include "fileservices/SpecialFolders.h"
#include "frame/ResumeNext.h"

namespace tessel::controls {

using child::ImageList;
using child::ListView;
using child::Timer;
using frame::OLE_COLOR;
using frame::Variant;
using frame::VarType;

namespace {

constexpr frame::TextSize designSize{4800, 3600};
constexpr int sizeColumn = 2;

struct Column {
    const char* caption;
    float width;  // twips
    const char* key;
    const char* tag;  // the number of the column that sorts for it; empty for itself
};
constexpr std::array columns = {
    Column{"Name", 2540, "", "13"},       Column{"Size", 1305, "", "8"},         Column{"Type", 2540, "", ""},
    Column{"Modified", 2540, "", "9"},    Column{"Created", 2540, "", "10"},     Column{"Changed", 582, "", ""},
    Column{"Folder", 6068, "Folder", ""}, Column{"SortedSize", 0, "", ""},       Column{"SortedModified", 0, "", ""},
    Column{"SortedCreated", 0, "", ""},   Column{"RealName", 0, "RealName", ""}, Column{"Refresh", 0, "Refresh", ""},
    Column{"SortName", 0, "", ""},
};

}  // namespace

FileView::FileView(frame::Host& host) : Control(host) {
    DesignPictures();
    DesignList();
    constexpr float messageHeight = 615;
    txtMessage.Move(120, 120, designSize.width - 240, messageHeight);
    txtMessage.SetBorderStyle(child::LabelBorderConstants::None);
    txtMessage.SetMultiLine(true);
    txtMessage.SetLocked(true);
    txtMessage.SetVisible(false);
    Connect();
}

void FileView::DesignPictures() {
    constexpr OLE_COLOR mask = 0xC0C0C0;
    constexpr int largeSide = 32, smallSide = 16;
    namespace designed = fileservices::designimages;
    const auto add = [](ImageList& images, std::string_view key, int side) {
        images.ListImages.Add({}, std::string(key), designed::Draw(key, side));
    };
    Image32.SetMaskColor(mask);
    Image16.SetMaskColor(mask);
    for (const auto key : {designed::sortDown, designed::sortUp}) add(Image16, key, smallSide);
    for (const auto key : {designed::driveUnavailable, designed::folderUnavailable, designed::fileFolder}) {
        add(Image32, key, largeSide);
        add(Image16, key, smallSide);
    }
    TempPic.SetVisible(false);
    TempPic.SetBorderStyle(0);
    TempPic.SetBackColor(mask);  // what an icon leaves free is clear in the lists
}

void FileView::DesignList() {
    ListFiles.Move(0, 0, designSize.width, designSize.height);
    for (const Column& column : columns) {
        child::ColumnHeader& header = ListFiles.ColumnHeaders.Add({}, column.key, column.caption, column.width);
        if (*column.tag) header.SetTag(column.tag);
    }
    ListFiles.ColumnHeaders.Item(sizeColumn).SetAlignment(child::AlignmentConstants::RightJustify);
    ListFiles.SetSortKey(subItem::sortName);
    ListFiles.SetIcons(&Image32);
    ListFiles.SetSmallIcons(&Image16);
    ListFiles.SetColumnHeaderIcons(&Image16);
    ListFiles.Rows().SetSource(&rows_);
}

void FileView::Connect() {
    ListFiles.Click.To<&FileView::ListClick>(*this);
    ListFiles.DblClick.To<&FileView::ListDblClick>(*this);
    ListFiles.KeyDown.To<&FileView::ListKeyDown>(*this);
    ListFiles.KeyPress.To<&FileView::ListKeyPress>(*this);
    ListFiles.KeyUp.To<&FileView::ListKeyUp>(*this);
    ListFiles.MouseDown.To<&FileView::ListMouseDown>(*this);
    ListFiles.MouseMove.To<&FileView::ListMouseMove>(*this);
    ListFiles.MouseUp.To<&FileView::ListMouseUp>(*this);
    ListFiles.ItemClick.To<&FileView::ListItemClick>(*this);
    ListFiles.ColumnClick.To<&FileView::ListColumnClick>(*this);
    RefreshTimer.Elapsed.To<&FileView::TimerElapsed>(*this);
}

template <auto Set, class T>
void FileView::SetStock(std::string_view key, const T& value) {
    (ListFiles.*Set)(value);
    PropertyChanged(key);
}

void FileView::SetBackColor(OLE_COLOR value) { SetStock<&ListView::SetBackColor>("BackColor", value); }
void FileView::SetForeColor(OLE_COLOR value) { SetStock<&ListView::SetForeColor>("ForeColor", value); }
void FileView::SetEnabled(bool value) { SetStock<&ListView::SetEnabled>("Enabled", value); }
void FileView::SetFont(const frame::FontRef& value) { SetStock<&ListView::SetFont>("Font", value); }
void FileView::SetBorderStyle(child::ListBorderConstants value) { SetStock<&ListView::SetBorderStyle>("BorderStyle", value); }
void FileView::SetMousePointer(std::int16_t value) { SetStock<&ListView::SetMousePointer>("MousePointer", value); }
void FileView::SetMouseIcon(const frame::PictureRef& value) { SetStock<&ListView::SetMouseIcon>("MouseIcon", value); }
void FileView::SetPicture(const frame::PictureRef& value) { SetStock<&ListView::SetPicture>("Picture", value); }
void FileView::SetPictureAlignment(child::ListPictureAlignmentConstants value) {
    SetStock<&ListView::SetPictureAlignment>("PictureAlignment", value);
}
void FileView::SetArrange(child::ListArrangeConstants value) { SetStock<&ListView::SetArrange>("Arrange", value); }
void FileView::SetAppearance(child::AppearanceConstants value) { SetStock<&ListView::SetAppearance>("Appearance", value); }
void FileView::SetHideColumnHeaders(bool value) { SetStock<&ListView::SetHideColumnHeaders>("HideColumnHeaders", value); }
void FileView::SetHideSelection(bool value) { SetStock<&ListView::SetHideSelection>("HideSelection", value); }
void FileView::SetMultiSelect(bool value) { SetStock<&ListView::SetMultiSelect>("MultiSelect", value); }
void FileView::SetAllowColumnReorder(bool value) { SetStock<&ListView::SetAllowColumnReorder>("AllowColumnReorder", value); }
void FileView::SetFlatScrollBar(bool value) { SetStock<&ListView::SetFlatScrollBar>("FlatScrollBar", value); }
void FileView::SetFullRowSelect(bool value) { SetStock<&ListView::SetFullRowSelect>("FullRowSelect", value); }
void FileView::SetGridLines(bool value) { SetStock<&ListView::SetGridLines>("GridLines", value); }
void FileView::SetHotTracking(bool value) { SetStock<&ListView::SetHotTracking>("HotTracking", value); }
void FileView::SetHoverSelection(bool value) { SetStock<&ListView::SetHoverSelection>("HoverSelection", value); }
void FileView::SetLabelWrap(bool value) { SetStock<&ListView::SetLabelWrap>("LabelWrap", value); }
void FileView::SetView(child::ListViewConstants value) { SetStock<&ListView::SetView>("View", value); }

void FileView::SetFolderPath(const std::string& value) {
    own.Path = value;
    PropertyChanged("Path");
}

void FileView::SetPathRoot(const std::string& value) {
    own.PathRoot = value;
    PropertyChanged("PathRoot");
    own.Path = own.PathRoot;
    PaintList();
}

void FileView::SetLimitToRoot(bool value) {
    own.LimitToRoot = value;
    PropertyChanged("LimitToRoot");
}

void FileView::SetShowFolders(bool value) {
    own.ShowFolders = value;
    PropertyChanged("ShowFolders");
    PaintList();
}

void FileView::SetShowFolderDetails(bool value) {
    own.ShowFolderDetails = value;
    PropertyChanged("ShowFolderDetails");
}

void FileView::SetAllowHiddenFiles(bool value) {
    own.AllowHiddenFiles = value;
    PropertyChanged("AllowHiddenFiles");
}

void FileView::SetAllowSystemFiles(bool value) {
    own.AllowSystemFiles = value;
    PropertyChanged("AllowSystemFiles");
}

void FileView::SetAllowLabelEdit(bool value) {
    own.AllowLabelEdit = value;
    ListFiles.SetLabelEdit(value ? child::ListLabelEditConstants::Manual : child::ListLabelEditConstants::Automatic);
    PropertyChanged("AllowLabelEdit");
}

void FileView::SetFilter(const std::string& value) {
    own.Filter = value;
    PropertyChanged("Filter");
}

void FileView::SetOLEDragMode(child::OLEDragConstants value) {
    own.OLEDragMode = value;
    PropertyChanged("OLEDragMode");
}

void FileView::SetOLEDropMode(child::OLEDropConstants value) {
    own.OLEDropMode = value;
    PropertyChanged("OLEDropMode");
}

void FileView::SetRefreshInterval(std::int32_t value) {
    RefreshTimer.SetInterval(value);
    PropertyChanged("RefreshInterval");
}

// Life.

void FileView::Initialize() { own.PersonalPath = Host().Module<fileservices::SpecialFolders>().SpecialFolderPath("Personal"); }

void FileView::Resize() {
    ListFiles.SetWidth(Surface().ScaleWidth());
    ListFiles.SetHeight(Surface().ScaleHeight());
}

void FileView::Show() { PaintList(); }

void FileView::Paint() { ListFiles.ColumnHeaders.Item(sizeColumn).SetAlignment(child::AlignmentConstants::RightJustify); }

void FileView::WriteProperties(frame::PropertyBag& bag) const {
    FinishTotal();
    Control::WriteProperties(bag);
}

frame::TextSize FileView::DesignSize() const { return designSize; }

// What the list reports.

void FileView::ListClick() { ForwardEvent(fileview::Click); }
void FileView::ListDblClick() { ForwardEvent(fileview::DblClick); }
void FileView::ListKeyDown(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(fileview::KeyDown, keyCode, shift); }
void FileView::ListKeyPress(std::int16_t keyAscii) { ForwardEvent(fileview::KeyPress, keyAscii); }
void FileView::ListKeyUp(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(fileview::KeyUp, keyCode, shift); }

void FileView::ListMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(fileview::MouseDown, button, shift, x, y);
}

void FileView::ListMouseMove(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(fileview::MouseMove, button, shift, x, y);
}

void FileView::ListMouseUp(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(fileview::MouseUp, button, shift, x, y);
}

void FileView::ListItemClick(std::int32_t index) {
    own.ItemIndex = index;
    ForwardEvent(fileview::ItemClick, index);
}

void FileView::ListColumnClick(std::int32_t index) { SortByColumn(index); }

/// Sorts by the hidden column whose texts order as those of the clicked one should; a second click turns the order round.
void FileView::SortByColumn(std::int32_t column) {
    using Order = child::ListSortOrderConstants;
    const Variant noIcon = std::int32_t{0};
    child::ColumnHeaders& headers = ListFiles.ColumnHeaders;
    frame::ResumeNext next;
    for (std::int32_t index = 1; index <= headers.Count(); ++index) next([&] { return headers.Item(index).SetIcon(noIcon); });
    std::int32_t target = column;
    next([&] {
        const Variant& tag = headers.Item(column).Tag();
        if (!tag.ToText().empty()) target = tag.ToLong();
    });
    const bool again = target == ListFiles.SortKey() + 1;
    const Order order = again && ListFiles.SortOrder() == Order::Ascending ? Order::Descending : Order::Ascending;
    const std::string_view picture =
        order == Order::Ascending ? fileservices::designimages::sortDown : fileservices::designimages::sortUp;
    next([&] { return headers.Item(column).SetIcon(picture); });
    if (!again) next([&] { ListFiles.SetSortKey(target - 1); });
    next([&] { ListFiles.SetSortOrder(order); });
    next([&] { ListFiles.SetSorted(true); });
}

// Helpers.

std::string FileView::JoinedPath(std::string_view folder, std::string_view name) const {
    return fileservices::BuildPath(folder, name, Disk().Separator());
}

fileservices::Collect& FileView::YieldEach(std::int32_t limit) const {
    auto& collect = Host().Module<fileservices::Collect>();
    collect.CollectYield(Variant(limit));
    return collect;
}

// Tables.

namespace {

/// A key that a load sets through the control's own setter, which reports it.
template <auto Get, auto Set>
constexpr frame::BagKey settingKey(std::string_view name, frame::BagDefault otherwise) {
    using C = typename frame::detail::MemberFunction<decltype(Get)>::Class;
    using T = std::remove_cvref_t<typename frame::detail::MemberFunction<decltype(Get)>::Result>;
    return {
        name,
        otherwise,
        otherwise,
        false,
        [](frame::Control& control, const Variant& value) { (frame::detail::Of<C>(control).*Set)(frame::FromVariant<T>(value)); },
        [](const frame::Control& control) -> Variant { return frame::ToVariant((frame::detail::Of<C>(control).*Get)()); }};
}

/// A key that lives in `ListFiles`.
template <auto Get, auto Set, class... Default>
constexpr frame::BagKey OfList(std::string_view name, Default... otherwise) {
    return frame::childKey<&FileView::ListFiles, Get, Set>(name, otherwise...);
}

}  // namespace

struct FileView::Tables {
    static constexpr std::array members = {
        frame::property<&FileView::BackColor, &FileView::SetBackColor>(
            "BackColor", "Returns/sets the background color used to display text and graphics in an object.",
            frame::dispatch::backColor),
        frame::property<&FileView::ForeColor, &FileView::SetForeColor>(
            "ForeColor", "Returns/sets the foreground color used to display text and graphics in an object.",
            frame::dispatch::foreColor),
        frame::property<&FileView::Enabled, &FileView::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events.",
            frame::dispatch::enabled),
        frame::property<&FileView::Font, &FileView::SetFont>("Font", "Returns a Font object.", frame::dispatch::font),
        frame::property<&FileView::BorderStyle, &FileView::SetBorderStyle>(
            "BorderStyle", "Returns/sets the border style for an object.", frame::dispatch::borderStyle),
        frame::property<&FileView::MousePointer, &FileView::SetMousePointer>(
            "MousePointer", "Returns/sets the type of mouse pointer displayed over the list."),
        frame::property<&FileView::MouseIcon, &FileView::SetMouseIcon>("MouseIcon", "Sets a custom mouse icon."),
        frame::property<&FileView::Picture, &FileView::SetPicture>("Picture", "Returns/sets the picture behind the items."),
        frame::property<&FileView::PictureAlignment, &FileView::SetPictureAlignment>(
            "PictureAlignment", "Returns/sets where the picture behind the items stands."),
        frame::property<&FileView::Arrange, &FileView::SetArrange>("Arrange", "Returns/sets how icons fall into place."),
        frame::property<&FileView::Appearance, &FileView::SetAppearance>(
            "Appearance", "Returns/sets whether or not an object is painted with 3-D effects.", frame::dispatch::appearance),
        frame::property<&FileView::HideColumnHeaders, &FileView::SetHideColumnHeaders>(
            "HideColumnHeaders", "Whether the report view has no column headers."),
        frame::property<&FileView::HideSelection, &FileView::SetHideSelection>(
            "HideSelection", "Whether the selection is not shown while the list has not the focus."),
        frame::property<&FileView::MultiSelect, &FileView::SetMultiSelect>("MultiSelect", "Whether several items may be selected."),
        frame::property<&FileView::AllowColumnReorder, &FileView::SetAllowColumnReorder>("AllowColumnReorder",
                                                                                         "Whether the user may move columns."),
        frame::property<&FileView::FlatScrollBar, &FileView::SetFlatScrollBar>("FlatScrollBar",
                                                                               "Whether the scroll bars are flat."),
        frame::property<&FileView::FullRowSelect, &FileView::SetFullRowSelect>(
            "FullRowSelect", "Whether a selected item is marked over all columns."),
        frame::property<&FileView::GridLines, &FileView::SetGridLines>(
            "GridLines", "Whether lines part the rows and columns of the report view."),
        frame::property<&FileView::HotTracking, &FileView::SetHotTracking>("HotTracking",
                                                                           "Whether the item under the pointer is highlighted."),
        frame::property<&FileView::HoverSelection, &FileView::SetHoverSelection>(
            "HoverSelection", "Whether the item on which the pointer rests is selected."),
        frame::property<&FileView::LabelWrap, &FileView::SetLabelWrap>(
            "LabelWrap", "Whether long labels of large icons go on in the next line."),
        frame::property<&FileView::View, &FileView::SetView>("View",
                                                             "Returns/sets the view: large icons, small icons, list or report."),
        frame::property<&FileView::FolderPath, &FileView::SetFolderPath>("path", "The folder, or the word, that is shown now."),
        frame::property<&FileView::PathRoot, &FileView::SetPathRoot>("PathRoot",
                                                                     "The folder, or the word, with which the view begins."),
        frame::property<&FileView::LimitToRoot, &FileView::SetLimitToRoot>("LimitToRoot",
                                                                           "Whether going up stops at the root of the view."),
        frame::property<&FileView::ShowFolders, &FileView::SetShowFolders>("ShowFolders", "Whether folders are listed."),
        frame::property<&FileView::ShowFolderDetails, &FileView::SetShowFolderDetails>(
            "ShowFolderDetails", "Whether folders show their number of files and their dates."),
        frame::property<&FileView::AllowHiddenFiles, &FileView::SetAllowHiddenFiles>("AllowHiddenFiles",
                                                                                     "Whether hidden files are listed."),
        frame::property<&FileView::AllowSystemFiles, &FileView::SetAllowSystemFiles>("AllowSystemFiles",
                                                                                     "Whether system files are listed."),
        frame::property<&FileView::AllowLabelEdit, &FileView::SetAllowLabelEdit>(
            "AllowLabelEdit", "Whether the user may rename items by their labels."),
        frame::property<&FileView::Filter, &FileView::SetFilter>("Filter", "A pattern that the names of listed items match."),
        frame::property<&FileView::OLEDragMode, &FileView::SetOLEDragMode>("OLEDragMode", "Whether drags start by themselves."),
        frame::property<&FileView::OLEDropMode, &FileView::SetOLEDropMode>("OLEDropMode", "How drops on the list are handled."),
        frame::property<&FileView::RefreshInterval, &FileView::SetRefreshInterval>(
            "RefreshInterval", "Milliseconds between two refreshes; 0 for none."),
        frame::readOnlyProperty<&FileView::TotalSize>("TotalSize", "The bytes in view, those of all sub-folders among them."),
        frame::readOnlyProperty<&FileView::ItemCount>("ItemCount", "The number of items."),
        frame::readOnlyProperty<&FileView::ImageCount>("ImageCount", "The number of images."),
        frame::readOnlyProperty<&FileView::ItemPath>("ItemPath", "The path of the current item."),
        frame::readOnlyProperty<&FileView::ItemSize>("ItemSize", "The size of the current item in bytes."),
        frame::readOnlyProperty<&FileView::ItemType>("ItemType", "The type of the current item."),
        frame::runTimeProperty<&FileView::ItemIndex, &FileView::SetItemIndex>("ItemIndex", "The current item, from 1."),
        frame::runTimeProperty<&FileView::ItemDisplayName, &FileView::SetItemDisplayName>("ItemDisplayName",
                                                                                          "The label of the current item."),
        frame::runTimeProperty<&FileView::ItemName, &FileView::SetItemName>("ItemName",
                                                                            "The name of the current item on the disk."),
        frame::runTimeProperty<&FileView::ItemIcon, &FileView::SetItemIcon>("ItemIcon",
                                                                            "The key of the current item's large image."),
        frame::runTimeProperty<&FileView::ItemSmallIcon, &FileView::SetItemSmallIcon>("ItemSmallIcon",
                                                                                      "The key of the current item's small image."),
        frame::runTimeProperty<&FileView::ItemSelected, &FileView::SetItemSelected>("ItemSelected",
                                                                                    "Whether the current item is selected."),
        frame::runTimeProperty<&FileView::ItemTag, &FileView::SetItemTag>("ItemTag",
                                                                          "Whatever the program keeps with the current item."),
        frame::runTimeProperty<&FileView::ItemBold, &FileView::SetItemBold>("ItemBold", "Kept for the program."),
        frame::runTimeProperty<&FileView::SelectedItem, &FileView::SetSelectedItem>("SelectedItem", "The selected item, from 1."),
        frame::runTimeProperty<&FileView::ImageIndex, &FileView::SetImageIndex>("ImageIndex", "The current image, from 1."),
        frame::runTimeProperty<&FileView::ImageSmall, &FileView::SetImageSmall>("ImageSmall",
                                                                                "Whether the small images are meant."),
        frame::runTimeProperty<&FileView::ImageKey, &FileView::SetImageKey>("ImageKey", "The key of the current image."),
        frame::runTimeProperty<&FileView::ImageTag, &FileView::SetImageTag>("ImageTag",
                                                                            "Whatever the program keeps with the current image."),
        frame::method<&FileView::Refresh>("Refresh", "Looks for changes on the disk.", {}, frame::dispatch::refresh),
        frame::method<&FileView::GoUp>("GoUp", "Shows the folder above."),
        frame::method<&FileView::Search>("Search", "Searches for files. The results are displayed and the current PathRoot lost.",
                                         {"SearchFor", "SearchRoot", "SearchSubdirectories"}),
        frame::method<&FileView::ImageAddNew>("ImageAddNew", "Adds an image.", {"MyImage", "MyKey"}),
        frame::method<&FileView::ImageRemove>("ImageRemove", "Removes an image.", {"MyKey"}),
        frame::method<&FileView::ItemAddNew>("ItemAddNew", "Adds a file or folder to the list.", {"Filename"}),
        frame::method<&FileView::ItemRemove>("ItemRemove", "Takes an item off the list.", {"Index"}),
        frame::method<&FileView::ItemClear>("ItemClear", "Takes all items off the list."),
        // 62 and 63 are OLEDrag and AddNewFolder.
        frame::method<&FileView::ItemSetupIcon>("ItemSetupIcon", "Gives an item the icon of its file.", {"Index"}, 64),
        frame::method<&FileView::ImageLoadFileType>("ImageLoadFileType", "Loads the icon of a type of files.", {"ExtensionName"},
                                                    65),
    };
    static constexpr std::array<const frame::EventInfo*, 29> events = {
        &fileview::AfterAddItem,
        &fileview::BeforeAddItem,
        &fileview::AfterPaint,
        &fileview::BeforePaint,
        &fileview::AfterDelete,
        &fileview::BeforeDelete,
        &fileview::AfterOpenItem,
        &fileview::BeforeOpenItem,
        &fileview::AfterLabelEdit,
        &fileview::BeforeLabelEdit,
        &fileview::NeedMyFolders,
        &fileview::ItemClick,
        &fileview::RefreshFoundChanges,
        &fileview::ChangedFolder,
        &fileview::OLEStartDrag,
        &fileview::OLESetData,
        &fileview::OLEGiveFeedback,
        &fileview::OLEDragOver,
        &fileview::OLEDragDrop,
        &fileview::OLECompleteDrag,
        &fileview::Click,
        &fileview::DblClick,
        &fileview::KeyDown,
        &fileview::KeyPress,
        &fileview::KeyUp,
        &fileview::MouseDown,
        &fileview::MouseMove,
        &fileview::MouseUp,
        &fileview::BeforePopup,
    };
    static constexpr std::array kept = {
        OfList<&ListView::BackColor, &ListView::SetBackColor>("BackColor", VarType::Long, 0x80000005),
        OfList<&ListView::ForeColor, &ListView::SetForeColor>("ForeColor", VarType::Long, 0x80000008),
        OfList<&ListView::Enabled, &ListView::SetEnabled>("Enabled", VarType::Boolean, true),
        OfList<&ListView::Font, &ListView::SetFont>("Font", frame::ambientFont),
        OfList<&ListView::BorderStyle, &ListView::SetBorderStyle>("BorderStyle", VarType::Integer, 1),
        frame::key<&FileView::own, &Own::Path>("Path", ""),
        frame::key<&FileView::own, &Own::PathRoot>("PathRoot", ""),
        frame::key<&FileView::own, &Own::LimitToRoot>("LimitToRoot", VarType::Boolean, true),
        frame::key<&FileView::own, &Own::ShowFolders>("ShowFolders", VarType::Boolean, true),
        OfList<&ListView::MousePointer, &ListView::SetMousePointer>("MousePointer", VarType::Integer, 0),
        settingKey<&FileView::MouseIcon, &FileView::SetMouseIcon>("MouseIcon", frame::noObject),
        settingKey<&FileView::Picture, &FileView::SetPicture>("Picture", frame::noObject),
        OfList<&ListView::PictureAlignment, &ListView::SetPictureAlignment>("PictureAlignment", VarType::Integer, 0),
        OfList<&ListView::Arrange, &ListView::SetArrange>("Arrange", VarType::Integer, 0),
        OfList<&ListView::Appearance, &ListView::SetAppearance>("Appearance", VarType::Integer, 1),
        OfList<&ListView::HideColumnHeaders, &ListView::SetHideColumnHeaders>("HideColumnHeaders", VarType::Boolean, false),
        OfList<&ListView::HideSelection, &ListView::SetHideSelection>("HideSelection", VarType::Boolean, false),
        OfList<&ListView::MultiSelect, &ListView::SetMultiSelect>("MultiSelect", VarType::Boolean, false),
        OfList<&ListView::AllowColumnReorder, &ListView::SetAllowColumnReorder>("AllowColumnReorder", VarType::Boolean, false),
        OfList<&ListView::FlatScrollBar, &ListView::SetFlatScrollBar>("FlatScrollBar", VarType::Boolean, false),
        OfList<&ListView::FullRowSelect, &ListView::SetFullRowSelect>("FullRowSelect", VarType::Boolean, false),
        OfList<&ListView::GridLines, &ListView::SetGridLines>("GridLines", VarType::Boolean, false),
        OfList<&ListView::HotTracking, &ListView::SetHotTracking>("HotTracking", VarType::Boolean, false),
        OfList<&ListView::HoverSelection, &ListView::SetHoverSelection>("HoverSelection", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::ItemIndex>("ItemIndex", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ItemDisplayName>("ItemDisplayName", ""),
        frame::key<&FileView::own, &Own::ItemCount>("ItemCount", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ItemIcon>("ItemIcon", ""),
        OfList<&ListView::LabelWrap, &ListView::SetLabelWrap>("LabelWrap", VarType::Boolean, true),
        OfList<&ListView::View, &ListView::SetView>("View", VarType::Integer, 3),
        frame::key<&FileView::own, &Own::ItemSmallIcon>("ItemSmallIcon", ""),
        frame::key<&FileView::own, &Own::ItemSelected>("ItemSelected", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ItemTag>("ItemTag", ""),
        frame::key<&FileView::own, &Own::ImageIndex>("ImageIndex", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ImageCount>("ImageCount", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ImageSmall>("ImageSmall", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::ImageKey>("ImageKey", ""),
        frame::key<&FileView::own, &Own::ShowFolderDetails>("ShowFolderDetails", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::ItemBold>("ItemBold", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::ItemName>("ItemName", ""),
        frame::key<&FileView::own, &Own::OLEDragMode>("OLEDragMode", VarType::Long, 1),
        frame::key<&FileView::own, &Own::OLEDropMode>("OLEDropMode", VarType::Long, 2),
        // An interval of 0 is left out on save, and the load then brings back 10,000: kept so that saved designs act the same.
        frame::childKey<&FileView::RefreshTimer, &Timer::Interval, &Timer::SetInterval>(
            "RefreshInterval", frame::ValueDefault(VarType::Integer, 10'000), frame::ValueDefault(VarType::Integer, 0)),
        frame::key<&FileView::own, &Own::Filter>("Filter", ""),
        frame::key<&FileView::own, &Own::TotalSize>("TotalSize", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::AllowHiddenFiles>("AllowHiddenFiles", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::AllowSystemFiles>("AllowSystemFiles", VarType::Boolean, false),
        frame::key<&FileView::own, &Own::AllowLabelEdit>("AllowLabelEdit", VarType::Boolean, true),
        frame::key<&FileView::own, &Own::ImageTag>("ImageTag", ""),
        frame::key<&FileView::own, &Own::ItemPath>("ItemPath", ""),
        frame::key<&FileView::own, &Own::SelectedItem>("SelectedItem", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ItemSize>("ItemSize", VarType::Integer, 0),
        frame::key<&FileView::own, &Own::ItemType>("ItemType", ""),
    };
    static constexpr std::array parts = {
        frame::part<&FileView::ListFiles>("ListFiles"),   frame::part<&FileView::Image32>("Image32"),
        frame::part<&FileView::Image16>("Image16"),       frame::part<&FileView::TempPic>("TempPic"),
        frame::part<&FileView::txtMessage>("txtMessage"), frame::part<&FileView::RefreshTimer>("RefreshTimer"),
    };
};

constexpr frame::ClassTable FileView::table{
    .name = "FileView", .members = Tables::members, .events = Tables::events, .bag = Tables::kept, .parts = Tables::parts};

}  // namespace tessel::controls
