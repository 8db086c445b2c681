#include "app/widgets.h"

#include <QComboBox>
#include <QLabel>
#include <QStyle>
#include <QStyleOptionComboBox>
#include <QStyleOptionFrame>

namespace app {

QSize ShortLineEdit::sizeHint() const {
    ensurePolished();
    const QMargins text = textMargins();
    QStyleOptionFrame option;
    initStyleOption(&option);
    // The same content box as QLineEdit's own hint, only as wide as the characters asked for.
    const QSize content(fontMetrics().horizontalAdvance(QString(characters_, u'W')) + text.left() +
                            text.right() + 4,
                        qMax(fontMetrics().height(), 14) + 2 + text.top() + text.bottom());
    return style()->sizeFromContents(QStyle::CT_LineEdit, &option, content, this);
}

EntryComboBox::EntryComboBox(const char* sample, QWidget* parent)
    : QComboBox(parent), sample_(QString::fromLatin1(sample)) {
    setEditable(true);
}

QSize EntryComboBox::sizeHint() const {
    ensurePolished();
    QStyleOptionComboBox option;
    initStyleOption(&option);
    // The text field's own margins and cursor, as a line edit of the same text would need.
    const QSize content(fontMetrics().horizontalAdvance(sample_) + 8,
                        qMax(fontMetrics().height(), 14) + 2);
    return style()->sizeFromContents(QStyle::CT_ComboBox, &option, content, this);
}

QString withAccessKey(const QString& caption, const QString& marked) {
    if (QString(marked).remove(u'&') == caption) return marked;
    return QString(caption).replace(u'&', QStringLiteral("&&"));
}

void nameField(QWidget* field, const char* name, QLabel* label) {
    field->setAccessibleName(QString::fromLatin1(name));
    if (auto* combo = qobject_cast<QComboBox*>(field); combo != nullptr && combo->lineEdit()) {
        combo->lineEdit()->setAccessibleName(QString::fromLatin1(name));
    }
    if (label != nullptr) label->setBuddy(field);
}

}  // namespace app
