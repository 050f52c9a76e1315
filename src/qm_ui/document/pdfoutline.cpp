#include "qm_ui/document/pdfoutline.h"

#define POINTERHOLDER_TRANSITION 4 // std::shared_ptr in its interface
#include <qpdf/QPDF.hh>
#include <qpdf/QPDFObjectHandle.hh>
#include <qpdf/QPDFPageDocumentHelper.hh>
#include <qpdf/QPDFWriter.hh>

namespace {

/// An entry of the outline: a chapter with its parts.
struct T_ENTRY {
    const T_PAGE_MARK* mark = nullptr;
    std::vector<T_ENTRY> parts{};
};

std::vector<T_ENTRY> TreeOf(const std::vector<T_PAGE_MARK>& marks, std::size_t& at, int level)
{
    std::vector<T_ENTRY> out;
    while (at < marks.size() && marks[at].level >= level) {
        out.push_back({&marks[at]});
        const int own = marks[at++].level;
        out.back().parts = TreeOf(marks, at, own + 1);
    }
    return out;
}

class COutlineMaker {
public:
    explicit COutlineMaker(QPDF& pdf)
        : m_pdf(pdf), m_pages(QPDFPageDocumentHelper(pdf).getAllPages())
    {
    }

    /// Fills First, Last and Count of the parent; the entries are open.
    int Add(QPDFObjectHandle parent, const std::vector<T_ENTRY>& entries)
    {
        QPDFObjectHandle before;
        int count = 0;
        for (const T_ENTRY& entry : entries) {
            QPDFObjectHandle item = Item(parent, *entry.mark);
            if (before.isInitialized()) {
                item.replaceKey("/Prev", before);
                before.replaceKey("/Next", item);
            } else {
                parent.replaceKey("/First", item);
            }
            before = item;
            count += 1 + Add(item, entry.parts);
        }
        if (!before.isInitialized()) return 0;
        parent.replaceKey("/Last", before);
        parent.replaceKey("/Count", QPDFObjectHandle::newInteger(count));
        return count;
    }

private:
    QPDFObjectHandle Item(const QPDFObjectHandle& parent, const T_PAGE_MARK& mark)
    {
        constexpr double kPointsPerPx = 0.75;
        const double top = (CDocumentPages::SizePx().height() - mark.y) * kPointsPerPx;
        QPDFObjectHandle where = QPDFObjectHandle::newArray();
        where.appendItem(m_pages.at(mark.page).getObjectHandle());
        where.appendItem(QPDFObjectHandle::newName("/XYZ"));
        where.appendItem(QPDFObjectHandle::newNull());
        where.appendItem(QPDFObjectHandle::newReal(top, 1));
        where.appendItem(QPDFObjectHandle::newNull());
        QPDFObjectHandle item = m_pdf.makeIndirectObject(QPDFObjectHandle::newDictionary());
        item.replaceKey("/Title", QPDFObjectHandle::newUnicodeString(mark.title.toStdString()));
        item.replaceKey("/Parent", parent);
        item.replaceKey("/Dest", where);
        return item;
    }

    QPDF& m_pdf;
    std::vector<QPDFPageObjectHelper> m_pages;
};

} // namespace

std::string FinishPdf(const std::string& bytes, const std::vector<T_PAGE_MARK>& marks,
                      const std::string& program)
{
    QPDF pdf;
    pdf.processMemoryFile("pages", bytes.data(), bytes.size());
    std::size_t at = 0;
    QPDFObjectHandle root = pdf.makeIndirectObject(QPDFObjectHandle::newDictionary());
    root.replaceKey("/Type", QPDFObjectHandle::newName("/Outlines"));
    COutlineMaker(pdf).Add(root, TreeOf(marks, at, 1));
    pdf.getRoot().replaceKey("/Outlines", root);
    pdf.getRoot().replaceKey("/PageMode", QPDFObjectHandle::newName("/UseOutlines"));
    QPDFObjectHandle info = pdf.getTrailer().getKey("/Info");
    if (info.isDictionary()) {
        info.removeKey("/CreationDate");
        info.replaceKey("/Creator", QPDFObjectHandle::newUnicodeString(program));
    }
    QPDFWriter writer(pdf);
    writer.setOutputMemory();
    writer.setDeterministicID(true);
    writer.write();
    const std::shared_ptr<Buffer> out = writer.getBufferSharedPointer();
    return {reinterpret_cast<const char*>(out->getBuffer()), out->getSize()};
}
