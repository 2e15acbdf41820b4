// Fields to type in, of one line and of several.
#include "platform/user/controls/control.h"

#include "platform/gdi/encoding.h"

#include <QLineEdit>
#include <QPlainTextEdit>
#include <QValidator>

#include <algorithm>

namespace seam {

namespace {

/// What stays of a text in the program's character set, with a question mark for each character
/// that has no byte there. The user sees at once what is kept.
QString keptText(const QString& typed) {
    const std::string bytes = toWindows1252(typed);
    return fromWindows1252(bytes.data(), bytes.size());
}

class KeptText : public QValidator {
  public:
    using QValidator::QValidator;

    State validate(QString& typed, int& cursor) const override {
        cursor = static_cast<int>(keptText(typed.left(cursor)).size());
        typed = keptText(typed);
        return Acceptable;
    }
};

class LineEdit : public Control {
  public:
    LineEdit(const ControlTemplate& made, QWidget& dialog) : edit_(new QLineEdit(&dialog)) {
        LineEdit::setText(made.text);
        edit_->setValidator(new KeptText(edit_));
        edit_->setTextMargins(0, 0, 0, 0);
    }

    QWidget& widget() override {
        return *edit_;
    }

    std::string text() const override {
        return toWindows1252(edit_->text());
    }

    /// What the program writes may be longer than what can be typed.
    void setText(const std::string& text) override {
        const QString shown = fromWindows1252(text.data(), text.size());
        edit_->setMaxLength(std::max(limit_, static_cast<int>(shown.size())));
        edit_->setText(shown);
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM /*lParam*/) override {
        if (message != EM_LIMITTEXT) {
            return std::nullopt;
        }
        limit_ = static_cast<int>(wParam == 0 ? most : std::min(wParam, WPARAM{most}));
        edit_->setMaxLength(std::max(limit_, static_cast<int>(edit_->text().size())));
        return 0;
    }

  private:
    static constexpr int most = 32767; // what a limit of 0 stands for, too

    QLineEdit* edit_;
    int limit_ = most;
};

class TextEdit : public Control {
  public:
    TextEdit(const ControlTemplate& made, QWidget& dialog) : edit_(new QPlainTextEdit(&dialog)) {
        edit_->setTabChangesFocus(true);
        edit_->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        edit_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        edit_->document()->setDocumentMargin(1);
        QTextOption option = edit_->document()->defaultTextOption();
        option.setAlignment((made.style & ES_CENTER) != 0 ? Qt::AlignHCenter : Qt::AlignLeft);
        edit_->document()->setDefaultTextOption(option);
        TextEdit::setText(made.text);
        QObject::connect(edit_, &QPlainTextEdit::textChanged, edit_, [this] { holdToLimit(); });
    }

    QWidget& widget() override {
        return *edit_;
    }

    std::string text() const override {
        QString whole = edit_->document()->toRawText(); // the plain one has no hard blanks
        for (const QChar lineBreak :
             {QChar(QChar::ParagraphSeparator), QChar(QChar::LineSeparator)}) {
            whole.replace(lineBreak, QLatin1Char('\r'));
        }
        return toWindows1252(whole);
    }

    void setText(const std::string& text) override {
        const QSignalBlocker quiet(edit_);
        edit_->setPlainText(fromWindows1252(text.data(), text.size())
                                .replace(QLatin1String("\r\n"), QLatin1String("\r"))
                                .replace(QLatin1Char('\r'), QLatin1Char('\n')));
        accepted_ = edit_->toPlainText().size();
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM /*lParam*/) override {
        if (message != EM_LIMITTEXT) {
            return std::nullopt;
        }
        limit_ = static_cast<qsizetype>(wParam);
        return 0;
    }

  private:
    /// What was typed or pasted goes in as far as there is room for it. Undo takes it out whole.
    void holdToLimit() {
        const QSignalBlocker quiet(edit_);
        QTextCursor cursor = edit_->textCursor();
        cursor.joinPreviousEditBlock();
        keepBytes(edit_->textCursor());
        const qsizetype size = edit_->toPlainText().size();
        const qsizetype excess = limit_ > 0 ? std::min(size - limit_, size - accepted_) : 0;
        if (excess > 0) {
            cursor.movePosition(QTextCursor::Left, QTextCursor::KeepAnchor,
                                static_cast<int>(excess));
            cursor.removeSelectedText();
        }
        cursor.endEditBlock();
        accepted_ = edit_->toPlainText().size();
    }

    /// From the end, as a character may become shorter.
    void keepBytes(QTextCursor cursor) const {
        const QString typed = edit_->toPlainText();
        for (qsizetype end = typed.size(), at = 0; end > 0; end = at) {
            const bool pair =
                end > 1 && typed[end - 1].isLowSurrogate() && typed[end - 2].isHighSurrogate();
            at = end - (pair ? 2 : 1);
            const QString one = typed.mid(at, end - at);
            if (const QString kept = keptText(one); kept != one) {
                cursor.setPosition(static_cast<int>(at));
                cursor.setPosition(static_cast<int>(end), QTextCursor::KeepAnchor);
                cursor.insertText(kept);
            }
        }
    }

    QPlainTextEdit* edit_;
    qsizetype accepted_ = 0; // what there was when the limit last held
    qsizetype limit_ = 0;
};

} // namespace

std::unique_ptr<Control> makeEdit(const ControlTemplate& made, HWND /*handle*/, QWidget& dialog) {
    if ((made.style & ES_MULTILINE) != 0) {
        return std::make_unique<TextEdit>(made, dialog);
    }
    return std::make_unique<LineEdit>(made, dialog);
}

} // namespace seam
