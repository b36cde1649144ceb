#include "hosts/qt/WidgetPeer.h"

#include "frame/Control.h"
#include "frame/child/ComboList.h"
#include "frame/child/Label.h"
#include "frame/child/ListView.h"
#include "frame/child/PictureBox.h"
#include "frame/child/TextBox.h"
#include "frame/child/TreeView.h"
#include "hosts/qt/ComboListPeer.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/LabelPeer.h"
#include "hosts/qt/ListViewPeer.h"
#include "hosts/qt/PictureBoxPeer.h"
#include "hosts/qt/Site.h"
#include "hosts/qt/TextBoxPeer.h"
#include "hosts/qt/TreeViewPeer.h"

namespace tessel::qt {

WidgetPeer::WidgetPeer(frame::ChildControl& child, QWidget* widget) : child_(child), widget_(widget) {
    widget->setParent(static_cast<Site*>(child.Owner().Site())->surface());
    widget->setObjectName(ToQt(child.Name()));
    widget->show();
}

WidgetPeer::~WidgetPeer() {
    if (!widget_) return;
    widget_->hide();
    widget_->deleteLater();
}

void WidgetPeer::FollowChild() {
    if (!widget_) return;
    widget_->setGeometry(PixelRect(child_.Left(), child_.Top(), child_.Width(), child_.Height()));
    widget_->setVisible(child_.Visible());
    widget_->setEnabled(child_.Enabled());
    if (const QString tip = ToQt(child_.ToolTipText()); widget_->toolTip() != tip) widget_->setToolTip(tip);
}

std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl& child) {
    if (auto* combo = dynamic_cast<child::ComboList*>(&child)) return std::make_unique<ComboListPeer>(*combo);
    if (auto* label = dynamic_cast<child::Label*>(&child)) return std::make_unique<LabelPeer>(*label);
    if (auto* list = dynamic_cast<child::ListView*>(&child)) return std::make_unique<ListViewPeer>(*list);
    if (auto* picture = dynamic_cast<child::PictureBox*>(&child)) return std::make_unique<PictureBoxPeer>(*picture);
    if (auto* text = dynamic_cast<child::TextBox*>(&child)) return std::make_unique<TextBoxPeer>(*text);
    if (auto* tree = dynamic_cast<child::TreeView*>(&child)) return std::make_unique<TreeViewPeer>(*tree);
    return nullptr;
}

}  // namespace tessel::qt
