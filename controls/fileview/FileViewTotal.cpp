#include <limits>

#include "controls/fileview/FileView.h"

/// What would make the rows of a listing wait: the size of the whole tree, and the number of files in each folder. Both are found
/// out in idle time, in small steps, or when they are read.
namespace tessel::controls {

frame::Variant FileView::TotalSize() const {
    FinishTotal();
    return frame::Variant::FromCount(static_cast<std::int64_t>(own.TotalSize));
}

void FileView::SetTotal(double bytes) {
    own.TotalSize = bytes;
    own.unmeasured.clear();
}

/// A small tree is measured at once.
void FileView::AddTreeToTotal(const std::string& folder) {
    constexpr std::size_t entriesAtOnce = 250;
    std::unique_ptr<frame::TreeSize> tree = Disk().MeasureTree(folder);
    if (!tree->Step(entriesAtOnce)) return AddToTotal(static_cast<double>(tree->Bytes()));
    own.unmeasured.push_back(std::move(tree));
    own.unmeasuredFolder = folder;
    idleWork_.Start();
}

/// A measurement of the same folder that is still under way goes on: one begun anew at each refresh might never end.
void FileView::MeasureAgain(const std::string& folder) {
    if (!own.unmeasured.empty() && own.unmeasuredFolder == folder) return;
    SetTotal(0);
    AddTreeToTotal(folder);
}

void FileView::FinishTotal() const {
    for (const auto& tree : own.unmeasured) own.TotalSize += static_cast<double>(tree->Finish());
    own.unmeasured.clear();
}

void FileView::FinishCounting() {
    FinishTotal();
    rows_.CountSome(std::numeric_limits<std::size_t>::max());
}

bool FileView::WorkInIdleTime() {
    constexpr std::size_t entriesAtOnce = 4000, foldersAtOnce = 16;
    if (!Site()) return false;
    if (own.listings > 0) return true;  // rows come first
    if (own.unmeasured.empty()) {
        rows_.CountSome(foldersAtOnce);
    } else if (frame::TreeSize& tree = *own.unmeasured.back(); !tree.Step(entriesAtOnce)) {
        AddToTotal(static_cast<double>(tree.Bytes()));
        own.unmeasured.pop_back();
        if (own.unmeasured.empty()) TotalSizeReady();
    }
    return !own.unmeasured.empty() || rows_.HasUncounted();
}

}  // namespace tessel::controls
