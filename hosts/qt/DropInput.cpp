#include "hosts/qt/DropInput.h"

#include <QMimeData>
#include <QUrl>
#include <utility>

#include "hosts/qt/Convert.h"
#include "hosts/qt/PointerInput.h"

namespace tessel::qt {

namespace {

constexpr std::int16_t textFormat = 1;

child::DragDataRef DataOf(const QMimeData& mime) {
    auto data = std::make_shared<frame::DragData>();
    if (mime.hasText()) data->SetData(frame::Variant(FromQt(mime.text())), textFormat);
    for (const QUrl& url : mime.urls())
        if (url.isLocalFile()) data->Files.Add(FromQt(url.toLocalFile()));
    return data;
}

std::int32_t EffectsOf(Qt::DropActions actions) {
    return (actions & Qt::CopyAction ? frame::dropEffects::copy : 0) | (actions & Qt::MoveAction ? frame::dropEffects::move : 0);
}

}  // namespace

void DropInput::Enter(QDropEvent& event, QPointF at) {
    data_ = event.mimeData() ? DataOf(*event.mimeData()) : std::make_shared<frame::DragData>();
    Report(event, at, child::DragOverConstants::Enter);
}

void DropInput::Over(QDropEvent& event, QPointF at) { Report(event, at, child::DragOverConstants::Over); }

void DropInput::Report(QDropEvent& event, QPointF at, child::DragOverConstants state) {
    if (!Wanted() || !data_) return event.ignore();
    last_ = at;
    std::int32_t effect = EffectsOf(event.possibleActions());
    child_->OLEDragOverInput(data_, effect, ButtonsOf(event.buttons()), ShiftOf(event.modifiers()), Twips(at.x()), Twips(at.y()),
                             state);
    Answer(event, effect);
}

void DropInput::Leave() {
    const auto data = std::exchange(data_, nullptr);
    if (!Wanted() || !data) return;
    std::int32_t effect = frame::dropEffects::none;
    child_->OLEDragOverInput(data, effect, 0, 0, Twips(last_.x()), Twips(last_.y()), child::DragOverConstants::Leave);
}

void DropInput::Drop(QDropEvent& event, QPointF at) {
    const auto data = std::exchange(data_, nullptr);
    if (!Wanted() || !data) return event.ignore();
    std::int32_t effect = EffectsOf(event.possibleActions());
    child_->OLEDragDropInput(data, effect, ButtonsOf(event.buttons()), ShiftOf(event.modifiers()), Twips(at.x()), Twips(at.y()));
    Answer(event, effect);
}

void DropInput::Answer(QDropEvent& event, std::int32_t effect) {
    effect &= EffectsOf(event.possibleActions());
    if (effect == frame::dropEffects::none) return event.ignore();
    if (effect & EffectsOf(event.proposedAction()))
        event.setDropAction(event.proposedAction());
    else
        event.setDropAction(effect & frame::dropEffects::copy ? Qt::CopyAction : Qt::MoveAction);
    event.accept();
}

}  // namespace tessel::qt
