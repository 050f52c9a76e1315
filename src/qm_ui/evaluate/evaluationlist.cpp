#include "qm_ui/evaluate/deskfields.h"
#include "qm_ui/evaluate/overlayplot.h"
#include "qm_ui/plot/plot.h"

#include <QFontMetrics>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPainter>
#include <QPixmap>
#include <QSignalBlocker>

namespace {

QString Qt8(const std::string& text)
{
    return QString::fromStdString(text);
}

/// The verdict's word in white on its colour; as wide as the widest of them.
QPixmap Chip(EVALUATION_VERDICT verdict, const QFont& base, double ratio)
{
    constexpr int kPad = 6, kHeight = 18, kSmall = 8; // px, px, pt
    constexpr int kCount = static_cast<int>(EVALUATION_VERDICT::Refused) + 1;
    QFont font = base;
    font.setPointSize(kSmall);
    font.setBold(true);
    int width = 0;
    for (int v = 0; v < kCount; ++v)
        width = std::max(width, QFontMetrics(font).horizontalAdvance(
                                    Qt8(VerdictText(static_cast<EVALUATION_VERDICT>(v)))));
    QPixmap chip(QSizeF(width + 2 * kPad, kHeight).toSize() * ratio);
    chip.setDevicePixelRatio(ratio);
    chip.fill(Qt::transparent);
    QPainter painter(&chip);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box(0, 0, width + 2 * kPad, kHeight);
    painter.setPen(Qt::NoPen);
    painter.setBrush(CPlot::Color(VerdictColor(verdict)));
    painter.drawRoundedRect(box, 4, 4);
    painter.setFont(font);
    painter.setPen(Qt::white);
    painter.drawText(box, Qt::AlignCenter, Qt8(VerdictText(verdict)));
    return chip;
}

class CEvaluationList : public CFormField {
public:
    CEvaluationList(CEvaluationDeskDlg& desk, const ChangedFn& changed, QWidget* parent)
        : m_desk(desk), m_list(new QListWidget(parent))
    {
        widget = m_list;
        m_list->setMinimumSize(250, 120);
        m_list->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        m_list->setSpacing(1);
        QObject::connect(m_list, &QListWidget::currentRowChanged, [this, changed](int row) {
            m_desk.OnChoose(row);
            changed();
        });
        QObject::connect(m_list, &QListWidget::itemChanged, [this, changed](QListWidgetItem* item) {
            m_desk.OnTick(m_list->row(item), item->checkState() == Qt::Checked);
            changed();
        });
    }
    void Show() override
    {
        const QSignalBlocker quiet(m_list);
        const std::vector<T_EVALUATION_ENTRY>& entries = m_desk.List();
        while (m_list->count() > std::ssize(entries))
            delete m_list->takeItem(m_list->count() - 1);
        while (m_list->count() < std::ssize(entries))
            new QListWidgetItem(m_list);
        for (int row = 0; row < m_list->count(); ++row)
            ShowRow(*m_list->item(row), row, entries[static_cast<std::size_t>(row)]);
        m_list->setCurrentRow(m_desk.Chosen());
    }

private:
    void ShowRow(QListWidgetItem& item, int row, const T_EVALUATION_ENTRY& entry)
    {
        const EVALUATION_VERDICT verdict = VerdictOf(entry);
        const QString verdictText = Qt8(VerdictText(verdict));
        const bool isStored = row != m_desk.Chosen() || !m_desk.HasUnsaved();
        const QString result = Qt8(ResultText(entry));
        const QString text = Qt8(entry.eval.name) + (isStored ? "" : " *") + "\n" +
                             Qt8(MethodText(entry.eval) + ", " + entry.eval.spectrum) + "\n" +
                             result;
        // Each setter tells the view, which paints again: what is the same stays.
        if (item.text() != text) item.setText(text);
        const QString tip = verdictText + ": " + Qt8(VerdictReason(entry)) + "\n" + result;
        if (item.toolTip() != tip) item.setToolTip(tip);
        const QString key = verdictText + QString::number(static_cast<int>(verdict));
        if (item.data(Qt::UserRole).toString() != key) {
            const QPixmap chip = Chip(verdict, m_list->font(), m_list->devicePixelRatioF());
            m_list->setIconSize(chip.deviceIndependentSize().toSize());
            QIcon icon(chip);
            icon.addPixmap(chip, QIcon::Selected); // not tinted
            item.setIcon(icon);
            item.setData(Qt::UserRole, key);
        }
        item.setData(Qt::AccessibleTextRole, text + "\n" + verdictText);
        item.setFlags(item.flags() | Qt::ItemIsUserCheckable);
        const Qt::CheckState ticked = m_desk.IsTicked(row) ? Qt::Checked : Qt::Unchecked;
        if (item.data(Qt::CheckStateRole) != QVariant(ticked)) item.setCheckState(ticked);
    }

    CEvaluationDeskDlg& m_desk;
    QListWidget* m_list;
};

/// A figure: its symbol over its value.
struct T_CARD_LABELS {
    QWidget* box = nullptr;
    QLabel *symbol = nullptr, *value = nullptr;
};

class CCards : public CFormField {
public:
    CCards(CEvaluationDeskDlg& desk, QWidget* parent) : m_desk(desk)
    {
        widget = new QWidget(parent);
        auto* row = new QHBoxLayout(widget);
        row->setContentsMargins(0, 0, 0, 0);
        row->setSpacing(4);
        m_verdict = new QLabel(widget);
        row->addWidget(m_verdict);
        m_why = new QLabel(widget);
        m_why->setWordWrap(true);
        row->addWidget(m_why, 1);
        for (T_CARD_LABELS& card : m_cards) {
            card.box = new QWidget(widget);
            auto* column = new QVBoxLayout(card.box);
            column->setContentsMargins(2, 0, 2, 0);
            column->setSpacing(0);
            card.symbol = new QLabel(card.box);
            card.value = new QLabel(card.box);
            QFont bold = card.value->font();
            bold.setBold(true);
            card.value->setFont(bold);
            card.value->setTextInteractionFlags(Qt::TextSelectableByMouse);
            column->addWidget(card.symbol);
            column->addWidget(card.value);
            row->addWidget(card.box, 1);
        }
    }
    void Show() override
    {
        const T_EVALUATION_ENTRY& entry = m_desk.Entry();
        const EVALUATION_VERDICT verdict = VerdictOf(entry);
        const bool answered = AnswerOf(entry.result).has_value();
        m_verdict->setPixmap(Chip(verdict, m_verdict->font(), m_verdict->devicePixelRatioF()));
        m_verdict->setAccessibleName(Qt8(VerdictText(verdict)));
        m_verdict->setToolTip(Qt8(VerdictReason(entry)));
        m_why->setVisible(!answered);
        m_why->setText(Qt8(VerdictReason(entry)));
        const std::vector<T_CARD> cards = CardsOf(entry);
        for (std::size_t i = 0; i < m_cards.size(); ++i) {
            m_cards[i].box->setVisible(answered);
            m_cards[i].box->setToolTip(Qt8(cards[i].definition));
            m_cards[i].symbol->setText(Qt8(cards[i].symbol));
            m_cards[i].value->setText(
                Qt8(cards[i].NumberText() + (cards[i].value ? " " + cards[i].unit : "")));
        }
    }

private:
    CEvaluationDeskDlg& m_desk;
    QLabel *m_verdict, *m_why;
    std::array<T_CARD_LABELS, kCardNames.size()> m_cards;
};

} // namespace

std::unique_ptr<CFormField> MakeEvaluationList(CEvaluationDeskDlg& desk, ChangedFn changed,
                                               QWidget* parent)
{
    return std::make_unique<CEvaluationList>(desk, changed, parent);
}

std::unique_ptr<CFormField> MakeCards(CEvaluationDeskDlg& desk, QWidget* parent)
{
    return std::make_unique<CCards>(desk, parent);
}
