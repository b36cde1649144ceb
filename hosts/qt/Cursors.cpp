#include "hosts/qt/Cursors.h"

#include <QPixmap>
#include <array>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

QCursor CursorOf(int pointer, const frame::PictureRef& icon) {
    constexpr int custom = 99;
    if (pointer == custom && icon && icon->Plane(1)) return QCursor(QPixmap::fromImage(ToQt(*icon, 1)));
    static constexpr std::array shapes = {
        Qt::ArrowCursor,     Qt::ArrowCursor,   Qt::CrossCursor,     Qt::IBeamCursor,   Qt::ArrowCursor,   Qt::SizeAllCursor,
        Qt::SizeBDiagCursor, Qt::SizeVerCursor, Qt::SizeFDiagCursor, Qt::SizeHorCursor, Qt::UpArrowCursor, Qt::WaitCursor,
        Qt::ForbiddenCursor, Qt::BusyCursor,    Qt::WhatsThisCursor, Qt::SizeAllCursor,
    };
    const bool known = pointer >= 0 && pointer < static_cast<int>(shapes.size());
    return known ? shapes[static_cast<std::size_t>(pointer)] : Qt::ArrowCursor;
}

}  // namespace tessel::qt
