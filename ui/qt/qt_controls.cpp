#include "ui/qt/qt_controls.h"

#include <QApplication>
#include <QCheckBox>
#include <QCloseEvent>
#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QWidget>

namespace ui::qt {

namespace {

bool ending = false;

std::function<void()>& refusalHook() {
    static std::function<void()> hook;
    return hook;
}

void refuseInput() {
    if (refusalHook()) {
        refusalHook()();
    } else {
        QApplication::beep();
    }
}

qsizetype controlCharacters(const QString& text) {
    return std::count_if(text.begin(), text.end(), [](QChar c) {
        const char16_t u = c.unicode();
        return u < 0x20 || (u >= 0x7F && u <= 0x9F);
    });
}

}  // namespace

QString toQt(const std::string& latin1) {
    return QString::fromLatin1(latin1.data(), static_cast<qsizetype>(latin1.size()));
}

std::string fromQt(const QString& text) {
    const QByteArray bytes = text.toLatin1();
    return std::string(bytes.constData(), static_cast<std::size_t>(bytes.size()));
}

void setRefusalHook(std::function<void()> hook) {
    refusalHook() = std::move(hook);
}

QValidator::State StorableTextValidator::validate(QString& input, int& /*pos*/) const {
    const bool beyondLatin1 =
        std::any_of(input.begin(), input.end(), [](QChar c) { return c.unicode() > 0xFF; });
    if (beyondLatin1 || controlCharacters(input) > controlCharacters(last_)) {
        refuseInput();
        return Invalid;
    }
    last_ = input;
    return Acceptable;
}

QtWindow::QtWindow(QWidget* widget) : widget_(widget) {
    widget_->installEventFilter(this);
}

void QtWindow::setEnding(bool value) {
    ending = value;
}

void QtWindow::show() {
    if (!loaded_) {
        loaded_ = true;
        if (onLoad) onLoad();
        if (!loaded_ || ending) return;  // the load handler closed it or ended the program
        widget_->show();
        return;
    }
    bringToFront();
}

void QtWindow::unload() {
    if (!loaded_) return;
    if (widget_->isHidden()) {
        // A hidden window gets no close event from close(), yet its unload still runs.
        loaded_ = false;
        if (onUnload) onUnload();
        return;
    }
    closingByCode_ = true;
    widget_->close();
    closingByCode_ = false;
}

void QtWindow::setEnabled(bool enabled) {
    widget_->setEnabled(enabled);
}

bool QtWindow::isEnabled() const {
    return widget_->isEnabled();
}

void QtWindow::bringToFront() {
    widget_->show();
    widget_->raise();
    widget_->activateWindow();
}

void QtWindow::setCaption(const std::string& caption) {
    widget_->setWindowTitle(toQt(caption));
}

bool QtWindow::eventFilter(QObject* watched, QEvent* event) {
    if (watched != widget_ || event->type() != QEvent::Close) return false;
    if (ending) return false;
    if (!widget_->isEnabled() && !closingByCode_) {
        event->ignore();  // a window waiting for its dialog cannot be closed
        return true;
    }
    if (loaded_) {
        loaded_ = false;
        if (onUnload) onUnload();
    }
    return false;
}

QtButton::QtButton(QPushButton* button) : button_(button) {
    button_->setAutoDefault(false);
    button_->setDefault(false);
    QObject::connect(button_, &QPushButton::clicked, [this] {
        if (onClick) onClick();
    });
}

void QtButton::setCaption(const std::string& caption) {
    button_->setText(toQt(caption));
}

void QtButton::setEnabled(bool enabled) {
    button_->setEnabled(enabled);
}

QtLabel::QtLabel(QLabel* label) : label_(label) {
    label_->setTextFormat(Qt::PlainText);
}

void QtLabel::setCaption(const std::string& caption) {
    label_->setText(toQt(caption));
}

std::string QtLabel::caption() const {
    return fromQt(label_->text());
}

QtComboBox::QtComboBox(QComboBox* combo) : combo_(combo) {
    combo_->setInsertPolicy(QComboBox::NoInsert);
    combo_->setMaxVisibleItems(12);
    if (combo_->isEditable()) {
        combo_->setCompleter(nullptr);  // typing shows exactly what was typed
        validator_ = new StorableTextValidator(combo_);
        combo_->setValidator(validator_);
    }
    // Keys are filtered on the combo box itself: its line edit forwards key presses to it.
    combo_->installEventFilter(this);
}

void QtComboBox::addItem(const std::string& text) {
    combo_->addItem(toQt(text));
}

void QtComboBox::setItems(std::vector<std::string> items) {
    const QString keep = combo_->currentText();
    QStringList texts;
    for (const auto& item : items) texts.append(toQt(item));
    combo_->clear();
    combo_->addItems(texts);
    if (combo_->isEditable()) {
        if (validator_ != nullptr) validator_->setBaseline(keep);
        combo_->setEditText(keep);
    }
}

int QtComboBox::itemCount() const {
    return combo_->count();
}

std::string QtComboBox::itemText(int index) const {
    return fromQt(combo_->itemText(index));
}

std::string QtComboBox::text() const {
    return fromQt(combo_->currentText());
}

bool QtComboBox::setText(const std::string& text) {
    if (combo_->isEditable()) {
        // No item is current afterwards, so Down in the box starts again at the first item
        // rather than after the one last picked.
        combo_->setCurrentIndex(-1);
        if (validator_ != nullptr) validator_->setBaseline(toQt(text));
        combo_->setEditText(toQt(text));
        return true;
    }
    const int index = combo_->findText(toQt(text), Qt::MatchExactly | Qt::MatchCaseSensitive);
    if (index < 0) return false;
    combo_->setCurrentIndex(index);
    return true;
}

std::size_t QtComboBox::selectedLength() const {
    const QLineEdit* edit = combo_->lineEdit();
    return edit == nullptr ? 0 : static_cast<std::size_t>(edit->selectedText().size());
}

void QtComboBox::setEnabled(bool enabled) {
    combo_->setEnabled(enabled);
}

bool QtComboBox::isEnabled() const {
    return combo_->isEnabled();
}

bool QtComboBox::eventFilter(QObject* watched, QEvent* event) {
    if (watched != combo_ || event->type() != QEvent::KeyPress || !combo_->isEditable()) {
        return false;
    }
    auto* keyEvent = static_cast<QKeyEvent*>(event);
    int key = 0;
    if (keyEvent->key() == Qt::Key_Backspace) {
        key = 8;
    } else if (!keyEvent->text().isEmpty() && keyEvent->text().at(0).isPrint()) {
        const char16_t code = keyEvent->text().at(0).unicode();
        if (code > 0xFF) {
            refuseInput();  // not a Latin-1 character: never typed
            return true;
        }
        key = code;
    } else {
        return false;  // navigation and editing keys are not characters
    }
    if (onKeyPress) onKeyPress(key);
    return key == 0;
}

QtTextBox::QtTextBox(QLineEdit* edit) : edit_(edit), validator_(new StorableTextValidator(edit)) {
    edit_->setValidator(validator_);
}

std::string QtTextBox::text() const {
    return fromQt(edit_->text());
}

void QtTextBox::setText(const std::string& text) {
    // Text set by the program is kept whole even beyond the typing limit.
    edit_->setMaxLength(
        std::max<int>({limit_ > 0 ? limit_ : 32767, static_cast<int>(text.size())}));
    validator_->setBaseline(toQt(text));
    edit_->setText(toQt(text));
}

void QtTextBox::setMaxLength(int length) {
    limit_ = length;
    applyLimit();
}

void QtTextBox::applyLimit() {
    const int current = static_cast<int>(edit_->text().size());
    edit_->setMaxLength(std::max(limit_ > 0 ? limit_ : 32767, current));
}

void QtTextBox::setFocus() {
    edit_->setFocus(Qt::OtherFocusReason);
}

bool QtTextBox::hasFocus() const {
    return edit_->hasFocus();
}

QtCheckBox::QtCheckBox(QCheckBox* box) : box_(box) {}

void QtCheckBox::setCaption(const std::string& caption) {
    box_->setText(toQt(caption));
}

int QtCheckBox::value() const {
    switch (box_->checkState()) {
        case Qt::Checked:
            return 1;
        case Qt::PartiallyChecked:
            return 2;
        default:
            return 0;
    }
}

void QtCheckBox::setValue(int value) {
    if (value == 2) box_->setTristate(true);
    box_->setCheckState(value == 1   ? Qt::Checked
                        : value == 2 ? Qt::PartiallyChecked
                                     : Qt::Unchecked);
}

}  // namespace ui::qt
