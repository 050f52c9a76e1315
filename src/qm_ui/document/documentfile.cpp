#include "qm_ui/document/documentfile.h"

#include "qm_rps/document/documenthtml.h"
#include "qm_ui/document/documentpages.h"
#include "qm_ui/document/documentpictures.h"
#include "qm_ui/document/pdfoutline.h"

#include <QBuffer>
#include <QCryptographicHash>
#include <QFile>
#include <QHashFunctions>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>

namespace {

DOC_DRAW_FN Drawings(CDBDoc& doc)
{
    return [&doc](const T_DOC_PICTURE& picture) { return DrawingOf(doc, picture); };
}

/// The element alone: without what stands before it in a file.
std::string InlineSvg(const T_DRAWING& drawing)
{
    const std::string svg = SvgText(drawing);
    const std::size_t from = svg.find("<svg");
    return from == std::string::npos ? std::string() : svg.substr(from);
}

/// While it lives, hash tables have one order in every run: fonts of a PDF stand in that order.
class CSameOrder {
public:
    CSameOrder() { QHashSeed::setDeterministicGlobalSeed(); }
    CSameOrder(const CSameOrder&) = delete;
    CSameOrder& operator=(const CSameOrder&) = delete;
    ~CSameOrder() { QHashSeed::resetRandomGlobalSeed(); }
};

std::string PdfBytes(CDBDoc& doc, const T_DOCUMENT& document)
{
    const CSameOrder order;
    constexpr int kDpi = 1200;
    constexpr double kScreenDpi = 96.0;
    QByteArray bytes;
    QBuffer buffer(&bytes);
    const CDocumentPages pages(document, Drawings(doc));
    if (!buffer.open(QIODevice::WriteOnly)) return {};
    QPdfWriter pdf(&buffer);
    pdf.setTitle(QString::fromStdString(document.title));
    pdf.setResolution(kDpi);
    pdf.setPageSize(QPageSize(QPageSize::A4));
    pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
    QPainter painter;
    if (!painter.begin(&pdf)) return {};
    painter.scale(kDpi / kScreenDpi, kDpi / kScreenDpi);
    for (std::size_t page = 0; page < pages.Count(); ++page) {
        if (page > 0) pdf.newPage();
        pages.Draw(painter, page);
    }
    if (!painter.end()) return {};
    return FinishPdf(bytes.toStdString(), pages.Marks(), document.program);
}

} // namespace

std::string FileHash(const std::string& path)
{
    QFile file(QString::fromStdString(path));
    QCryptographicHash hash(QCryptographicHash::Sha256);
    if (!file.open(QIODevice::ReadOnly) || !hash.addData(&file)) return {};
    return hash.result().toHex().toStdString();
}

int WriteDocumentHtml(CDBDoc& doc, const T_DOCUMENT& document, const std::string& path,
                      std::string& error)
{
    return WriteOffscreen(path, error, [&] {
        return HtmlOf(document, [&doc](const T_DOC_PICTURE& picture) {
            return InlineSvg(DrawingOf(doc, picture));
        });
    });
}

int WriteDocumentPdf(CDBDoc& doc, const T_DOCUMENT& document, const std::string& path,
                     std::string& error)
{
    return WriteOffscreen(path, error, [&] { return PdfBytes(doc, document); });
}
