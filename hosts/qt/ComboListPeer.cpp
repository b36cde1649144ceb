#include "hosts/qt/ComboListPeer.h"

#include <QComboBox>
#include <QEvent>
#include <QListView>
#include <QWheelEvent>

#include "hosts/qt/ComboListModel.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/LabelPeer.h"

namespace tessel::qt {

/// The desktop's combo box over the rows of a list, and what it reports.
class ComboListWidget final : public QComboBox {
  public:
    explicit ComboListWidget(child::ComboList& list);
    /// The list goes: nothing is reported from now on.
    void Disconnect();
    void Follow();
    /// The height with the list's font.
    int NaturalHeight();

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override { event->ignore(); }
    void changeEvent(QEvent* event) override;

  private:
    void TakeFont();
    void TakeColors();
    void Chosen(int row);

    child::ComboList* list_;  // null once it has gone
    ComboListModel* rows_;
    KeyInput* keys_;
};

ComboListWidget::ComboListWidget(child::ComboList& list)
    : list_(&list), rows_(new ComboListModel(list, this)), keys_(new KeyInput(list, this)) {
    // Neither the size nor the popup may look at every row.
    setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    setMinimumContentsLength(1);
    setIconSize({1, 1});
    setStyleSheet("QComboBox { combobox-popup: 0; }");
    setMaxVisibleItems(16);
    auto* popup = new QListView(this);
    popup->setUniformItemSizes(true);
    popup->setTextElideMode(Qt::ElideRight);
    setModel(rows_);
    setView(popup);
    popup->installEventFilter(this);
    connect(this, &QComboBox::activated, this, [this](int row) { Chosen(row); });
}

void ComboListWidget::Disconnect() {
    list_ = nullptr;
    keys_->Disconnect();
    rows_->Disconnect();
}

void ComboListWidget::Follow() {
    if (!list_) return;
    TakeFont();
    TakeColors();
    const bool fresh = rows_->Follow();
    const int chosen = list_->ListIndex();
    if (currentIndex() != chosen) setCurrentIndex(chosen);
    if (fresh && view()->isVisible()) view()->setCurrentIndex(rows_->index(chosen, 0));
}

int ComboListWidget::NaturalHeight() {
    TakeFont();
    ensurePolished();
    return sizeHint().height();
}

void ComboListWidget::TakeFont() {
    if (!list_) return;
    const QFont wanted = ToQt(*list_->Font());
    if (font() != wanted) setFont(wanted);
}

void ComboListWidget::TakeColors() {
    constexpr int middle = 128;
    const frame::SystemColors& system = list_->Host().Colors();
    const frame::OLE_COLOR back = list_->BackColor(), fore = list_->ForeColor();
    QPalette wanted;
    if (back != frame::colors::windowBackground)
        for (const QPalette::ColorRole role : {QPalette::Base, QPalette::Button}) wanted.setColor(role, ToQt(back, system));
    if (fore != frame::colors::windowText) {
        QColor text = ToQt(fore, system);
        const QColor behind = parentWidget() && back == frame::colors::windowBackground
                                  ? parentWidget()->palette().color(QPalette::Button)
                                  : ToQt(back, system);
        if (back.IsSystem() && behind.lightness() < middle) text = Readable(text, behind);
        for (const QPalette::ColorGroup group : {QPalette::Active, QPalette::Inactive})
            for (const QPalette::ColorRole role : {QPalette::Text, QPalette::ButtonText}) wanted.setColor(group, role, text);
    }
    if (property("tessel_palette").value<QPalette>() == wanted) return;
    setProperty("tessel_palette", wanted);
    setPalette(wanted);
}

void ComboListWidget::Chosen(int row) {
    if (!list_) return;
    // Of other rows than are shown by now nothing was chosen.
    if (rows_->IsFresh())
        list_->ChooseInput(row);
    else
        Follow();
}

bool ComboListWidget::eventFilter(QObject* watched, QEvent* event) {
    if (list_ && watched == view() && event->type() == QEvent::KeyPress) {
        keys_->Press(static_cast<const QKeyEvent&>(*event));
        if (!list_) return true;
    }
    return QComboBox::eventFilter(watched, event);
}

void ComboListWidget::keyPressEvent(QKeyEvent* event) {
    keys_->Press(*event);
    if (list_) QComboBox::keyPressEvent(event);
}

void ComboListWidget::mouseDoubleClickEvent(QMouseEvent* event) {
    if (list_) list_->DblClickInput();
    if (list_) QComboBox::mouseDoubleClickEvent(event);
}

void ComboListWidget::changeEvent(QEvent* event) {
    QComboBox::changeEvent(event);
    if (!list_ || !rows_) return;
    if (event->type() == QEvent::PaletteChange) TakeColors();
    if (event->type() == QEvent::StyleChange && list_->Peer()) list_->HeightInput();
}

ComboListPeer::ComboListPeer(child::ComboList& list) : ComboListPeer(list, new ComboListWidget(list)) {}

ComboListPeer::ComboListPeer(child::ComboList& list, ComboListWidget* widget) : WidgetPeer(list, widget), shown_(widget) {}

ComboListPeer::~ComboListPeer() {
    if (shown_) shown_->Disconnect();
}

void ComboListPeer::Update() {
    if (!shown_) return;
    FollowChild();
    shown_->Follow();
}

float ComboListPeer::NaturalHeight() { return shown_ ? Twips(shown_->NaturalHeight()) : child::ComboList::heightTwips; }

}  // namespace tessel::qt
