#include "hosts/qt/FileIcons.h"

#include <QApplication>
#include <QFileInfo>
#include <QIcon>
#include <QMimeDatabase>
#include <QPainter>
#include <QPixmap>
#include <QStorageInfo>
#include <QStyle>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

namespace {

/// An icon by the first of these names that the theme has, otherwise one of the widget style.
struct Kind {
    QString themed;
    QStyle::StandardPixmap otherwise = QStyle::SP_FileIcon;

    Kind(std::initializer_list<QString> names, QStyle::StandardPixmap standard) : otherwise(standard) {
        for (const QString& name : names)
            if (themed.isEmpty() && QIcon::hasThemeIcon(name)) themed = name;
    }
    QIcon Icon() const { return themed.isEmpty() ? QApplication::style()->standardIcon(otherwise) : QIcon::fromTheme(themed); }
};

Kind KindOfDrive(const QStorageInfo& drive) {
    const QByteArray type = drive.fileSystemType();
    if (type == "iso9660" || type == "udf") return {{"media-optical", "drive-optical"}, QStyle::SP_DriveCDIcon};
    if (type.startsWith("nfs") || type == "cifs" || type == "smb3" || type == "fuse.sshfs")
        return {{"folder-remote", "network-server"}, QStyle::SP_DriveNetIcon};
    if (drive.rootPath().startsWith("/media/") || drive.rootPath().startsWith("/run/media/"))
        return {{"drive-removable-media", "drive-harddisk"}, QStyle::SP_DriveHDIcon};
    return {{"drive-harddisk"}, QStyle::SP_DriveHDIcon};
}

Kind KindOf(const QFileInfo& file, bool open) {
    if (file.isDir()) {
        // Only the spelling with a separator at its end names a drive.
        if (file.filePath().endsWith('/')) {
            const QStorageInfo drive(file.filePath());
            const QString root = drive.rootPath();
            if (file.filePath() == (root.endsWith('/') ? root : root + '/')) return KindOfDrive(drive);
        }
        if (open) return {{"folder-open", "folder"}, QStyle::SP_DirOpenIcon};
        return {{"folder"}, QStyle::SP_DirIcon};
    }
    const QMimeType type = QMimeDatabase().mimeTypeForFile(file, QMimeDatabase::MatchExtension);
    return {{type.iconName(), type.genericIconName(), "text-x-generic"}, QStyle::SP_FileIcon};
}

frame::PictureRef PictureOf(const QIcon& icon, int side) {
    std::vector<frame::PixelPlane> planes;
    for (const int scale : {1, 2}) {
        const QPixmap shown = icon.pixmap(QSize(side, side), scale);
        if (shown.isNull()) return nullptr;
        // A theme may have the icon in lesser sizes only: all planes are of one size.
        QImage image(side * scale, side * scale, QImage::Format_ARGB32_Premultiplied);
        image.fill(Qt::transparent);
        QPainter painter(&image);
        painter.setRenderHint(QPainter::SmoothPixmapTransform);
        painter.drawPixmap(image.rect(), shown);
        painter.end();
        planes.push_back(PlaneOf(image, scale));
    }
    return std::make_shared<frame::Picture>(std::move(planes), "");
}

}  // namespace

frame::PictureRef FileIcons::Of(const QString& path, int flags) {
    constexpr int smallForm = 1, openForm = 2, smallSide = 16, largeSide = 32;
    const QFileInfo file(path);
    if (!file.exists() && !file.isSymLink()) return nullptr;
    if (const QString look = QIcon::themeName() + '/' + QApplication::style()->name(); look != look_) {
        look_ = look;
        known_.clear();
    }
    const Kind kind = KindOf(file, (flags & openForm) != 0);
    const int side = flags & smallForm ? smallSide : largeSide;
    const auto [known, isNew] = known_.try_emplace({kind.themed, kind.otherwise, side});
    if (isNew) known->second = PictureOf(kind.Icon(), side);
    return known->second;
}

}  // namespace tessel::qt
