#include "qm_ui/plotfile.h"

#include "qm_ui/plot.h"

#include <QBuffer>
#include <QByteArray>
#include <QGuiApplication>
#include <QImage>
#include <QMarginsF>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QSaveFile>
#include <QString>
#include <QSvgGenerator>

#include <algorithm>
#include <array>
#include <clocale>
#include <cstdio>
#include <exception>
#include <memory>

namespace {

constexpr int kWidth = 960;      // px at 96 dpi
constexpr int kMaxHeight = 8000; // px; a higher page is cut
constexpr int kPngScale = 2;
constexpr int kPdfDpi = 1200;
constexpr double kScreenDpi = 96.0;
constexpr double kDotsPerMeter = kScreenDpi / 0.0254;

int Height(const T_PLOT& plot)
{
    const bool usable = plot.pageHeight >= 1.0 && plot.pageHeight <= kMaxHeight;
    return usable ? static_cast<int>(plot.pageHeight) : kMaxHeight;
}

bool Paint(QPaintDevice& device, double scale, const T_PLOT& plot)
{
    QPainter painter;
    if (!painter.begin(&device)) return false;
    painter.scale(scale, scale);
    CPlot::Draw(painter, QRectF(0, 0, kWidth, Height(plot)), plot, {});
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
bool PaintSvg(const T_PLOT& plot, QIODevice& out)
{
    const QString titleMark = QStringLiteral("plot-title-mark");
    const QString textMark = QStringLiteral("plot-description-mark");
    QByteArray bytes;
    QBuffer buffer(&bytes);
    QSvgGenerator svg;
    svg.setOutputDevice(&buffer);
    svg.setResolution(static_cast<int>(kScreenDpi));
    svg.setSize(QSize(kWidth, Height(plot)));
    svg.setViewBox(QRect(0, 0, kWidth, Height(plot)));
    svg.setTitle(titleMark);
    svg.setDescription(textMark);
    if (!buffer.open(QIODevice::WriteOnly) || !Paint(svg, 1.0, plot)) return false;
    ReplaceFirst(bytes, titleMark, plot.title);
    ReplaceFirst(bytes, textMark, plot.subtitle);
    return out.write(bytes) == bytes.size();
}

bool PaintPng(const T_PLOT& plot, QIODevice& out)
{
    QImage image(kPngScale * kWidth, kPngScale * Height(plot), QImage::Format_RGB32);
    if (image.isNull()) return false;
    image.setDotsPerMeterX(static_cast<int>(kPngScale * kDotsPerMeter));
    image.setDotsPerMeterY(static_cast<int>(kPngScale * kDotsPerMeter));
    return Paint(image, kPngScale, plot) && image.save(&out, "PNG");
}

bool PaintPdf(const T_PLOT& plot, QIODevice& out)
{
    constexpr double kPointsPerPx = 72.0 / kScreenDpi;
    QPdfWriter pdf(&out);
    pdf.setTitle(QString::fromStdString(plot.title));
    pdf.setResolution(kPdfDpi);
    const QSizeF size(kWidth * kPointsPerPx, Height(plot) * kPointsPerPx);
    pdf.setPageSize(QPageSize(size, QPageSize::Point, QString(), QPageSize::ExactMatch));
    pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
    return Paint(pdf, kPdfDpi / kScreenDpi, plot);
}

struct T_FORMAT {
    const char* extension;
    bool (*paint)(const T_PLOT&, QIODevice&);
};
constexpr std::array<T_FORMAT, 3> kFormats{
    {{".svg", PaintSvg}, {".png", PaintPng}, {".pdf", PaintPdf}}};

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

int WriteAll(const QString& path, const QByteArray& bytes, std::string& error)
{
    QSaveFile file(path); // a temporary file beside, renamed by commit
    const bool done =
        file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size() && file.commit();
    if (!done) error = path.toStdString() + ": can't write: " + file.errorString().toStdString();
    return done ? 1 : 0;
}

int WriteChecked(const T_PLOT& plot, const QString& path, std::string& error)
{
    const T_FORMAT* format = FindFormat(path);
    if (!format) {
        error = path.toStdString() + ": unknown picture format, use .svg, .png or .pdf";
        return 0;
    }
    const COffscreenApp app;
    QByteArray bytes;
    QBuffer buffer(&bytes);
    if (!buffer.open(QIODevice::WriteOnly) || !format->paint(plot, buffer) || bytes.isEmpty()) {
        error = path.toStdString() + ": the picture can't be drawn";
        return 0;
    }
    return WriteAll(path, bytes, error);
}

} // namespace

int WritePlotFile(const T_PLOT& plot, const std::string& path, std::string& error)
{
    error.clear();
    try {
        return WriteChecked(plot, QString::fromStdString(path), error);
    } catch (const std::exception& e) {
        error = path + ": " + e.what();
        return 0;
    }
}
