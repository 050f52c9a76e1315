#include "shell/thumbnails.h"

#include "qm_db/casefile.h"
#include "qm_rps/desk/framescene.h"
#include "qm_ui/frame/framelegend.h"

#include <QCryptographicHash>
#include <QDateTime>
#include <QDir>
#include <QFileInfo>
#include <QPainter>
#include <QStandardPaths>

namespace {

constexpr int kSharpness = 2; // pixels per px, for screens of 200 %

QString PlaceOf(const QString& path)
{
    const QByteArray name = QFileInfo(path).absoluteFilePath().toUtf8();
    const QString hash = QCryptographicHash::hash(name, QCryptographicHash::Sha1).toHex();
    return QStandardPaths::writableLocation(QStandardPaths::CacheLocation) + "/thumbnails/" + hash +
           ".png";
}

} // namespace

QPixmap DrawThumbnail(CDBDoc& doc)
{
    CFrameScene scene(doc);
    T_FRAME_SCENE frame = scene.Scene();
    frame.title.clear();
    T_FRAME_PICTURE picture;
    picture.scene = &frame;
    T_FRAME_OPTIONS options;
    options.drifts = false;
    // The legend below the frame is left off: the sheet is higher by what it takes.
    const QRectF sheet({0.0, 0.0}, QSizeF(kThumbnailSize));
    const double legend =
        sheet.bottom() - DrawFrameLegend(nullptr, sheet, picture, options).bottom();
    QPixmap out(kThumbnailSize * kSharpness);
    out.setDevicePixelRatio(kSharpness);
    out.fill(Qt::white);
    if (frame.nodes.empty()) return out;
    QPainter painter(&out);
    CFramePainter().Draw(painter, sheet.adjusted(0, 0, 0, legend), picture,
                         CameraFor(CFrameScene::FlatAxis(frame)), options);
    return out;
}

QPixmap KeptThumbnail(const QString& path)
{
    const QFileInfo file(path), kept(PlaceOf(path));
    if (!file.exists() || !kept.exists() || kept.lastModified() < file.lastModified()) return {};
    QPixmap out(kept.filePath());
    out.setDevicePixelRatio(kSharpness);
    return out;
}

void KeepThumbnail(const QString& path, const QPixmap& picture)
{
    const QString place = PlaceOf(path);
    if (!picture.isNull() && QFileInfo::exists(path) && QDir().mkpath(QFileInfo(place).path()))
        (void)picture.save(place, "PNG");
}

QPixmap DrawCaseThumbnail(const QString& path)
{
    CDBDoc* const current = CDBDoc::GetDocPoint();
    QPixmap out;
    {
        CDBDoc doc;
        T_MODEL_CONTENT content;
        T_FILE_ERROR error;
        if (CCaseFile::Read(path.toStdString(), content, error)) {
            doc.Data().Assign(std::move(content));
            out = DrawThumbnail(doc);
        }
    }
    CDBDoc::SetDocPoint(current);
    return out;
}
