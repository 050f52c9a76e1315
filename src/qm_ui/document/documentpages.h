// A document cut into pages: for PDF files, printers and previews.
#pragma once

#include "qm_ui/document/pageflow.h"

#include <QSizeF>

/// A chapter and where it stands.
struct T_PAGE_MARK {
    int level = 1; // from 1
    QString title;
    std::size_t page = 0; // index
    double y = 0.0;       // px at 96 dpi from the top of the page
};

/// A4 upright. Pictures are drawn when their page is; what they refer to must outlive the object.
class CDocumentPages {
public:
    CDocumentPages(const T_DOCUMENT& document, const DOC_DRAW_FN& drawing);

    static QSizeF SizePx() { return {793.7, 1122.5}; } // 210 x 297 mm at 96 dpi
    std::size_t Count() const { return m_pages.size(); }
    /// Draws a page at the painter's origin, which is scaled to px at 96 dpi.
    void Draw(QPainter& painter, std::size_t page) const;
    const std::vector<T_PAGE_MARK>& Marks() const { return m_marks; }

private:
    struct T_PLACED {
        std::shared_ptr<const T_FLOW_PIECE> piece;
        double y = 0.0;
    };
    using T_PAGE = std::vector<T_PLACED>;

    void Compose(std::vector<T_FLOW_PIECE> flow);
    void AddContents(const T_DOCUMENT& document);
    void DrawFrame(QPainter& painter, std::size_t page) const;

    std::vector<T_PAGE> m_pages;
    std::vector<T_PAGE_MARK> m_marks;
    QString m_title, m_program, m_pageText;
};
