#include "qm_ui/report/picturefile.h"

#include "qm_base/say.h"
#include "qm_db/filectrl.h"

#include <QBuffer>
#include <QByteArray>
#include <QGuiApplication>
#include <QImage>
#include <QMarginsF>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QString>
#include <QSvgGenerator>

#include <algorithm>
#include <array>
#include <clocale>
#include <cstdio>
#include <exception>
#include <memory>
#include <new>
#include <string_view>

namespace {

constexpr int kPixelScale = 2; // of the formats made of pixels
constexpr int kPdfDpi = 1200;
constexpr double kScreenDpi = 96.0;
constexpr double kDotsPerMeter = kScreenDpi / 0.0254;

bool Paint(QPaintDevice& device, double scale, const T_DRAWING& drawing)
{
    QPainter painter;
    if (!painter.begin(&device)) return false;
    painter.scale(scale, scale);
    drawing.draw(painter, QRectF({0, 0}, drawing.size));
    return painter.end();
}

void ReplaceFirst(QByteArray& bytes, const QString& mark, const std::string& text)
{
    const QByteArray from = mark.toUtf8();
    const qsizetype at = bytes.indexOf(from);
    if (at < 0) return;
    bytes.replace(at, from.size(), QString::fromStdString(text).toHtmlEscaped().toUtf8());
}

// The generator of some Qt versions writes title and description without escaping them: marks stand
// in for them while it writes.
bool PaintSvg(const T_DRAWING& drawing, QIODevice& out)
{
    const QString titleMark = QStringLiteral("plot-title-mark");
    const QString textMark = QStringLiteral("plot-description-mark");
    QByteArray bytes;
    QBuffer buffer(&bytes);
    QSvgGenerator svg;
    svg.setOutputDevice(&buffer);
    svg.setResolution(static_cast<int>(kScreenDpi));
    svg.setSize(drawing.size.toSize());
    svg.setViewBox(QRectF({0, 0}, drawing.size));
    svg.setTitle(titleMark);
    svg.setDescription(textMark);
    if (!buffer.open(QIODevice::WriteOnly) || !Paint(svg, 1.0, drawing)) return false;
    ReplaceFirst(bytes, titleMark, drawing.title);
    ReplaceFirst(bytes, textMark, drawing.subtitle);
    return out.write(bytes) == bytes.size();
}

bool PaintPixels(const T_DRAWING& drawing, QIODevice& out, const char* format)
{
    constexpr int kQuality = 95; // of JPEG
    QImage image((kPixelScale * drawing.size).toSize(), QImage::Format_RGB32);
    if (image.isNull()) return false;
    image.setDotsPerMeterX(static_cast<int>(kPixelScale * kDotsPerMeter));
    image.setDotsPerMeterY(static_cast<int>(kPixelScale * kDotsPerMeter));
    const bool jpeg = std::string_view(format) == "JPEG";
    return Paint(image, kPixelScale, drawing) && image.save(&out, format, jpeg ? kQuality : -1);
}

bool PaintPng(const T_DRAWING& drawing, QIODevice& out)
{
    return PaintPixels(drawing, out, "PNG");
}
bool PaintJpeg(const T_DRAWING& drawing, QIODevice& out)
{
    return PaintPixels(drawing, out, "JPEG");
}
bool PaintBmp(const T_DRAWING& drawing, QIODevice& out)
{
    return PaintPixels(drawing, out, "BMP");
}

bool PaintPdf(const T_DRAWING& drawing, QIODevice& out)
{
    constexpr double kPointsPerPx = 72.0 / kScreenDpi;
    QPdfWriter pdf(&out);
    pdf.setTitle(QString::fromStdString(drawing.title));
    pdf.setResolution(kPdfDpi);
    const QSizeF size = kPointsPerPx * drawing.size;
    pdf.setPageSize(QPageSize(size, QPageSize::Point, QString(), QPageSize::ExactMatch));
    pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
    return Paint(pdf, kPdfDpi / kScreenDpi, drawing);
}

struct T_FORMAT {
    const char* extension;
    bool (*paint)(const T_DRAWING&, QIODevice&);
};
constexpr std::array<T_FORMAT, 6> kFormats{{{".svg", PaintSvg},
                                            {".png", PaintPng},
                                            {".pdf", PaintPdf},
                                            {".jpg", PaintJpeg},
                                            {".jpeg", PaintJpeg},
                                            {".bmp", PaintBmp}}};

const T_FORMAT* FindFormat(const QString& path)
{
    const auto fits = [&](const T_FORMAT& f) {
        return path.endsWith(QLatin1String(f.extension), Qt::CaseInsensitive);
    };
    const auto it = std::find_if(kFormats.begin(), kFormats.end(), fits);
    return it == kFormats.end() ? nullptr : &*it;
}

void OnlySeriousMessages(QtMsgType type, const QMessageLogContext&, const QString& text)
{
    if (type == QtCriticalMsg || type == QtFatalMsg)
        std::fprintf(stderr, "%s\n", text.toLocal8Bit().constData());
}

// A Qt application without a screen for the life of this object, when there is none yet. Qt sets
// the process locale from the environment; numbers must stay in the C locale.
class COffscreenApp {
public:
    COffscreenApp()
    {
        if (QCoreApplication::instance()) return;
        const QtMessageHandler old = qInstallMessageHandler(OnlySeriousMessages);
        m_app = std::make_unique<QGuiApplication>(m_argc, m_argv.data());
        qInstallMessageHandler(old);
        std::setlocale(LC_NUMERIC, "C");
    }

private:
    std::array<char, 8> m_name{"qm-rps"};
    std::array<char, 12> m_option{"-platform"};
    std::array<char, 12> m_platform{"offscreen"};
    std::array<char*, 4> m_argv{m_name.data(), m_option.data(), m_platform.data(), nullptr};
    int m_argc = 3;
    std::unique_ptr<QGuiApplication> m_app;
};

int WriteAll(const std::string& path, const std::string& bytes, std::string& error)
{
    T_FILE_ERROR fault;
    const int done = CFileCtrl::WriteWholeFile(path, bytes, fault);
    error = fault.text;
    return done;
}

} // namespace

std::string SvgText(const T_DRAWING& drawing)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    if (!buffer.open(QIODevice::WriteOnly) || !PaintSvg(drawing, buffer)) return {};
    return bytes.toStdString();
}

int WriteOffscreen(const std::string& path, std::string& error,
                   const std::function<std::string()>& make)
{
    error.clear();
    try {
        const COffscreenApp app;
        const std::string bytes = make();
        if (!bytes.empty()) return WriteAll(path, bytes, error);
        error = path + ": " + Say("IDS_QM_UI_NOT_DRAWN");
    } catch (const std::bad_alloc&) {
        error = path + ": " + Say("IDS_QM_NO_MEMORY");
    } catch (const std::exception& e) {
        error = path + ": " + e.what();
    }
    return 0;
}

int WritePictureFile(const T_DRAWING& drawing, const std::string& path, std::string& error)
{
    const T_FORMAT* format = FindFormat(QString::fromStdString(path));
    if (!format) {
        error = path + ": unknown picture format, use .svg, .pdf, .png, .jpg or .bmp";
        return 0;
    }
    return WriteOffscreen(path, error, [&] {
        QByteArray bytes;
        QBuffer buffer(&bytes);
        const bool done = buffer.open(QIODevice::WriteOnly) && format->paint(drawing, buffer);
        return done ? bytes.toStdString() : std::string();
    });
}
