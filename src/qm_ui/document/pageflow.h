// The content of pages as a column of pieces, before it is cut into pages.
#pragma once

#include "qm_rps/document/document.h"
#include "qm_ui/report/picturefile.h"

#include <QPointF>
#include <QString>

#include <functional>
#include <memory>
#include <vector>

class QPainter;

/// One piece that is never cut: a line of a table, a paragraph, a picture. Lengths: pagetext.h.
struct T_FLOW_PIECE {
    double above = 0.0; // distance to the piece above it, not at the top of a page
    double height = 0.0;
    bool keepWithNext = false; // a heading, a caption, the head of a table
    bool onNewPage = false;
    bool opensChapter = false; // on a new page where little of this one is left
    std::function<void(QPainter&, QPointF)> draw{};
    /// Drawn again on top of every further page that the table needs; null: none.
    std::shared_ptr<const T_FLOW_PIECE> head{};
    /// A chapter for contents and bookmarks: its number and title; level from 1, 0: none.
    int level = 0;
    QString title{};
    /// Of a picture that may be drawn smaller where that saves a page: the least height, and the
    /// piece of another height.
    double least = 0.0; // 0: it stays as it is
    std::function<T_FLOW_PIECE(double height)> shrunk{};
};

using DOC_DRAW_FN = std::function<T_DRAWING(const T_DOC_PICTURE&)>;

/// Title block, chapters, sign-off; contents are made once the pages are known. `width` is that of
/// the text, `height` that of a page.
std::vector<T_FLOW_PIECE> FlowOf(const T_DOCUMENT& document, const DOC_DRAW_FN& drawing,
                                 double width, double height);
