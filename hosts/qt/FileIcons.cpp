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

constexpr int smallForm = 1, openForm = 2;

QIcon Themed(std::initializer_list<QString> names, QStyle::StandardPixmap otherwise) {
    for (const QString& name : names)
        if (QIcon::hasThemeIcon(name)) return QIcon::fromTheme(name);
    return QApplication::style()->standardIcon(otherwise);
}

QIcon DriveIcon(const QStorageInfo& drive) {
    const QByteArray type = drive.fileSystemType();
    if (type == "iso9660" || type == "udf") return Themed({"media-optical", "drive-optical"}, QStyle::SP_DriveCDIcon);
    if (type.startsWith("nfs") || type == "cifs" || type == "smb3" || type == "fuse.sshfs")
        return Themed({"folder-remote", "network-server"}, QStyle::SP_DriveNetIcon);
    if (drive.rootPath().startsWith("/media/") || drive.rootPath().startsWith("/run/media/"))
        return Themed({"drive-removable-media", "drive-harddisk"}, QStyle::SP_DriveHDIcon);
    return Themed({"drive-harddisk"}, QStyle::SP_DriveHDIcon);
}

QIcon IconOf(const QFileInfo& file, bool open) {
    if (file.isDir()) {
        // Only the spelling with a separator at its end names a drive.
        if (file.filePath().endsWith('/')) {
            const QStorageInfo drive(file.filePath());
            const QString root = drive.rootPath();
            if (file.filePath() == (root.endsWith('/') ? root : root + '/')) return DriveIcon(drive);
        }
        return open ? Themed({"folder-open", "folder"}, QStyle::SP_DirOpenIcon) : Themed({"folder"}, QStyle::SP_DirIcon);
    }
    const QMimeType type = QMimeDatabase().mimeTypeForFile(file, QMimeDatabase::MatchExtension);
    return Themed({type.iconName(), type.genericIconName(), "text-x-generic"}, QStyle::SP_FileIcon);
}

}  // namespace

frame::PictureRef FileIcon(const QString& path, int flags) {
    const QFileInfo file(path);
    if (!file.exists() && !file.isSymLink()) return nullptr;
    const QIcon icon = IconOf(file, (flags & openForm) != 0);
    const int side = flags & smallForm ? 16 : 32;
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
    return std::make_shared<frame::Picture>(std::move(planes), FromQt(path));
}

}  // namespace tessel::qt
