// Dialogs on screens of any density: nothing in them is cut. The density comes from outside, by
// QT_FONT_DPI, as the toolkit asks for it once in a process.
#include "platform/dialogs.h"
#include "platform/user/controls/control.h"
#include "platform/user/window.h"
#include "tests/user/test_window.h"

#include <QAbstractButton>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QRegularExpression>
#include <QStyle>
#include <QStyleOptionButton>

namespace {

QSize sizeOf(const QWidget& widget, const QString& text) {
    return widget.fontMetrics().size(Qt::TextShowMnemonic, text);
}

bool fits(const QSize& inner, const QSize& outer) {
    return inner.width() <= outer.width() && inner.height() <= outer.height();
}

bool fitsLabel(const QLabel& label) {
    const QStringList words = label.text().split(QRegularExpression(QStringLiteral("\\s")));
    return label.text().isEmpty() || (label.heightForWidth(label.width()) <= label.height() &&
                                      std::ranges::all_of(words, [&](const QString& word) {
                                          return sizeOf(label, word).width() <= label.width();
                                      }));
}

bool fitsButton(const QAbstractButton& button) {
    if (qobject_cast<const QPushButton*>(&button) == nullptr) {
        return fits(button.sizeHint(), {button.width(), button.sizeHint().height()}) &&
               sizeOf(button, button.text()).height() <= button.height() + 1;
    }
    QStyleOptionButton option;
    option.initFrom(&button);
    const QRect inside =
        button.style()->subElementRect(QStyle::SE_PushButtonContents, &option, &button);
    return fits(sizeOf(button, button.text()), inside.size());
}

/// Whether a control has room for what stands in it.
bool hasRoom(const QWidget& control) {
    if (const auto* label = qobject_cast<const QLabel*>(&control)) {
        return fitsLabel(*label);
    }
    if (const auto* button = qobject_cast<const QAbstractButton*>(&control)) {
        return fitsButton(*button);
    }
    const bool field = qobject_cast<const QLineEdit*>(&control) != nullptr ||
                       qobject_cast<const QPlainTextEdit*>(&control) != nullptr;
    return !field || control.fontMetrics().height() <= control.contentsRect().height();
}

LRESULT noAnswer(HWND /*dialog*/, UINT /*message*/, WPARAM /*wParam*/, LPARAM /*lParam*/) {
    return 0;
}

/// The controls of a dialog.
std::vector<const QWidget*> controlsOf(HWND dialog) {
    std::vector<const QWidget*> found;
    seam::forEachWindow([&](const seam::Window& window) {
        if (window.parent == dialog && window.control) {
            found.push_back(&window.control->widget());
        }
    });
    return found;
}

struct Resource {
    const char* name;
    int width; // in dialog units
    int number = 0;

    ResourceName key() const {
        return number != 0 ? ResourceName(number) : ResourceName(name);
    }
};

class Density : public testing::TestWithParam<Resource> {};

TEST_P(Density, DialogsGrowAndNothingInThemIsCut) {
    const HWND handle = CreateDialogParamA(nullptr, GetParam().key(), nullptr, noAnswer, 0);
    const auto controls = controlsOf(handle);
    ASSERT_FALSE(controls.empty());
    ShowWindow(handle, SW_SHOWNORMAL);
    test::handleWaiting();
    const QWidget& dialog = *controls.front()->window();
    const int dots = std::max(qEnvironmentVariableIntValue("QT_FONT_DPI"), 96);
    EXPECT_NEAR(dialog.width() * dialog.devicePixelRatio(), GetParam().width * 1.5 * dots / 96,
                dialog.devicePixelRatio());
    for (const QWidget* control : controls) {
        const std::string what = control->property("text").toString().toStdString() + " of " +
                                 control->metaObject()->className();
        EXPECT_TRUE(hasRoom(*control)) << what;
        EXPECT_TRUE(control->parentWidget()->rect().contains(control->geometry())) << what;
    }
    DestroyWindow(handle);
}

INSTANTIATE_TEST_SUITE_P(All, Density,
                         testing::Values(Resource{"setup", 175, 2003}, Resource{"about", 222},
                                         Resource{"configure", 185}, Resource{"framedit", 90}),
                         [](const auto& one) { return std::string(one.param.name); });

} // namespace
