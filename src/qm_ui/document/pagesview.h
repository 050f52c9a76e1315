// The pages of a document below each other.
#pragma once

#include "qm_ui/document/documentpages.h"

#include <QAbstractScrollArea>

#include <memory>

/// Pages are as wide as the window; only those on show are drawn. Page Up and Page Down go on by a
/// page.
class CPagesView : public QAbstractScrollArea {
public:
    explicit CPagesView(QWidget* parent = nullptr);
    /// Null: nothing is shown.
    void SetPages(std::shared_ptr<const CDocumentPages> pages);
    QString m_hint; // stands in the place of pages while there are none
    std::size_t Count() const { return m_pages ? m_pages->Count() : 0; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    double Scale() const; // widget px per page px
    double PageHeight() const;
    void UpdateBar();

    std::shared_ptr<const CDocumentPages> m_pages;
};
