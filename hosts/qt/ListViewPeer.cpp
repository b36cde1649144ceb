#include "hosts/qt/ListViewPeer.h"

#include "hosts/qt/Convert.h"

namespace tessel::qt {

ListViewPeer::ListViewPeer(child::ListView& list) : ListViewPeer(list, new ListWidget(list)) {}

ListViewPeer::ListViewPeer(child::ListView& list, ListWidget* widget) : WidgetPeer(list, widget), shown_(widget) {}

ListViewPeer::~ListViewPeer() {
    if (shown_) shown_->Disconnect();
}

void ListViewPeer::Update() {
    if (!shown_) return;
    FollowChild();
    shown_->Follow();
    follows_ = true;
}

// Until the list was shown for the first time the fixed rule answers, so that what it had been scrolled to is taken over.
child::ListScreen* ListViewPeer::Screen() { return shown_ && follows_ ? this : nullptr; }

void ListViewPeer::EditBegan(child::RowId row) {
    if (shown_) shown_->BeginEdit(row);
}

std::optional<ListViewPeer::Position> ListViewPeer::RowAt(float x, float y) {
    return shown_->RowAtInside({PixelsExactly(x), PixelsExactly(y)});
}

ListViewPeer::Position ListViewPeer::FirstVisible() { return shown_->FirstVisible(); }

ListViewPeer::RowPlace ListViewPeer::PlaceOf(Position row) {
    const QRectF place = shown_->PlaceInside(row);
    return {Twips(place.top()), Twips(place.height())};
}

void ListViewPeer::ScrollTo(Position row) { shown_->ScrollToTop(row); }

void ListViewPeer::MakeVisible(Position row) { shown_->MakeVisible(row); }

}  // namespace tessel::qt
