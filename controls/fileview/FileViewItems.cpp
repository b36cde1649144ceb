#include "controls/fileview/FileView.h"
#include "fileservices/CommonFile.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

/// The items and the images under the cursor.
namespace tessel::controls {

using frame::Variant;

std::string FileView::ItemText(int column) const {
    if (!ItemIndexValid(own.ItemIndex)) return {};
    const child::ListRows& rows = ListFiles.Rows();
    return rows.Text(rows.At(static_cast<child::ListRows::Position>(own.ItemIndex - 1)), column);
}

std::string FileView::ItemFullPath(std::int32_t index) const {
    const child::ListItemRef item = Item(index);
    return JoinedPath(item->SubItems(subItem::folder), item->SubItems(subItem::realName));
}

std::string FileView::ItemPath() const {
    return ItemIndexValid(own.ItemIndex) ? JoinedPath(own.Path, ItemText(subItem::realName)) : std::string();
}

std::int32_t FileView::ItemSize() const {
    frame::ResumeNext next;
    return next.Value([&] { return Variant(ItemText(subItem::sortedSize)).ToLong(); }, 0);
}

std::string FileView::ItemType() const { return ItemText(subItem::type); }

void FileView::SetItemIndex(std::int32_t value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(value)) return;
    own.ItemIndex = value;
    PropertyChanged("ItemIndex");
}

std::string FileView::ItemDisplayName() const { return ItemText(subItem::text); }

void FileView::SetItemDisplayName(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetText(value);
    PropertyChanged("ItemDisplayName");
}

std::string FileView::ItemName() const { return ItemText(subItem::realName); }

void FileView::SetItemName(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetText(value);
    bool putBack = false;
    RenameItem(value, putBack);
    PropertyChanged("ItemName");
}

/// `putBack` tells that a label is to show the old name again.
void FileView::RenameItem(const std::string& newName, bool& putBack) {
    putBack = true;
    const std::string name(frame::TrimBlanks(newName));
    if (name.empty()) return;
    const child::ListItemRef item = CurrentItem();
    // The name as given is compared: a change of case alone is no change.
    if (frame::EqualsNoCase(newName, item->SubItems(subItem::realName))) return;
    const std::string path = ItemFullPath(own.ItemIndex);
    const char separator = Disk().Separator();
    const bool sameExtension =
        frame::EqualsNoCase(fileservices::GetExtensionName(path, separator), fileservices::GetExtensionName(name, separator));
    if (!sameExtension && Host().Module<fileservices::CommonFile>().ConfirmExtensionChange() != frame::msgbox::answerYes) return;
    FinishCounting();
    const fileservices::FileSystemObject files(Host());
    if (files.FileExists(path))
        files.GetFile(path)->SetName(name);
    else
        files.GetFolder(path)->SetName(name);
    item->SetSubItems(subItem::realName, name);
    putBack = false;
}

std::string FileView::ItemIcon() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Icon().ToText() : std::string(); }

void FileView::SetItemIcon(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    frame::ResumeNext next;
    next([&] { return CurrentItem()->SetIcon(value); });
    next([&] { PropertyChanged("ItemIcon"); });
}

std::string FileView::ItemSmallIcon() const {
    return ItemIndexValid(own.ItemIndex) ? CurrentItem()->SmallIcon().ToText() : std::string();
}

void FileView::SetItemSmallIcon(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    frame::ResumeNext next;
    next([&] { return CurrentItem()->SetSmallIcon(value); });
    next([&] { PropertyChanged("ItemSmallIcon"); });
}

bool FileView::ItemSelected() const { return ItemIndexValid(own.ItemIndex) && CurrentItem()->Selected(); }

void FileView::SetItemSelected(bool value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetSelected(value);
    PropertyChanged("ItemSelected");
}

std::string FileView::ItemTag() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Tag().ToText() : std::string(); }

void FileView::SetItemTag(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetTag(value);
    PropertyChanged("ItemTag");
}

void FileView::SetItemBold(bool value) {
    RefuseAtDesignTime();
    own.ItemBold = value;
    PropertyChanged("ItemBold");
}

std::int32_t FileView::SelectedItem() const {
    const child::ListItemRef selected = ListFiles.SelectedItem();
    return selected ? selected->Index() : 0;
}

void FileView::SetSelectedItem(std::int32_t value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(value)) return;
    ListFiles.SetSelectedItem(Item(own.SelectedItem));
    PropertyChanged("SelectedItem");
}

std::int32_t FileView::ItemAddNew(const std::string& Filename) { return AddItemByPath(Filename); }

std::int32_t FileView::ItemRemove(const std::optional<Variant>& Index) {
    ListFiles.ListItems.Remove(Index.value_or(own.ItemIndex));
    return 0;
}

std::int32_t FileView::ItemClear() {
    ClearRows();
    ClearExeImages();
    return 0;
}

// Images.

void FileView::SetImageIndex(std::int32_t value) {
    RefuseAtDesignTime();
    own.ImageIndex = value;
    PropertyChanged("ImageIndex");
}

void FileView::SetImageSmall(bool value) {
    RefuseAtDesignTime();
    own.ImageSmall = value;
    PropertyChanged("ImageSmall");
}

std::string FileView::ImageKey() const { return ImageIndexValid() ? Images().Item(own.ImageIndex).Key() : std::string(); }

void FileView::SetImageKey(const std::string& value) {
    RefuseAtDesignTime();
    if (!ImageIndexValid()) return;
    Images().Item(own.ImageIndex).SetKey(value);
    PropertyChanged("ImageKey");
}

std::string FileView::ImageTag() const { return ImageIndexValid() ? Images().Item(own.ImageIndex).Tag().ToText() : std::string(); }

void FileView::SetImageTag(const std::string& value) {
    RefuseAtDesignTime();
    if (!ImageIndexValid()) return;
    Images().Item(own.ImageIndex).SetTag(value);
    PropertyChanged("ImageTag");
}

std::int32_t FileView::ImageAddNew(const Variant& MyImage, const std::string& MyKey) {
    frame::ResumeNext next;
    next([&] { Images().Add({}, MyKey, frame::FromVariant<frame::PictureRef>(MyImage)); });
    return next.Failed() ? next.Number() : ImageCount();
}

Variant FileView::ImageRemove(const Variant& MyKey) {
    frame::ResumeNext next;
    next([&] { Images().Remove(MyKey); });
    return std::int32_t{next.Number()};
}

}  // namespace tessel::controls
