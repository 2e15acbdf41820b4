// Fields to type in, of one line and of several.
#include "platform/user/controls/control.h"

#include "platform/gdi/encoding.h"

#include <QLineEdit>
#include <QPlainTextEdit>

#include <algorithm>

namespace seam {

namespace {

class LineEdit : public Control {
  public:
    LineEdit(const ControlTemplate& made, QWidget& dialog) : edit_(new QLineEdit(&dialog)) {
        LineEdit::setText(made.text);
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
        accepted_ = edit_->toPlainText();
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM /*lParam*/) override {
        if (message != EM_LIMITTEXT) {
            return std::nullopt;
        }
        limit_ = static_cast<qsizetype>(wParam);
        return 0;
    }

  private:
    /// What would make the text too long is not taken: it stays as it was before.
    void holdToLimit() {
        const QString now = edit_->toPlainText();
        if (limit_ > 0 && now.size() > limit_ && now.size() > accepted_.size()) {
            const int at =
                edit_->textCursor().position() - static_cast<int>(now.size() - accepted_.size());
            const QSignalBlocker quiet(edit_);
            edit_->setPlainText(accepted_);
            QTextCursor cursor = edit_->textCursor();
            cursor.setPosition(std::clamp(at, 0, static_cast<int>(accepted_.size())));
            edit_->setTextCursor(cursor);
        } else {
            accepted_ = now;
        }
    }

    QPlainTextEdit* edit_;
    QString accepted_;
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
