// A card of the start page: the picture of a model, its name, and where it lies.
#pragma once

#include <QAbstractButton>
#include <QPixmap>

#include <functional>

class QToolButton;

/// A button with the whole card as its ground. A file that is gone is grey, can't be pressed, and
/// has a button that removes it from the list.
class CModelCard : public QAbstractButton {
public:
    CModelCard(const QString& name, const QString& place, QWidget* parent);

    void SetPicture(const QPixmap& picture);
    /// The file is gone. remove: called when the person takes it off the list.
    void SetGone(const QString& words, const QString& removeText, std::function<void()> remove);
    bool IsGone() const { return m_remove != nullptr; }
    QToolButton* RemoveButton() const { return m_remove; }

    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;

private:
    QString m_place;
    QPixmap m_picture;
    QToolButton* m_remove = nullptr;
};
