// The editor's main window on the real screen, pixel by pixel, on screens of three sizes.
#include "tests/program/run.h"
#include "tests/program/sketch.h"

#include <set>

#include <QPainter>

namespace {

using namespace ground;

constexpr const char* title = "Toon File Editor";
constexpr QPoint corner(14, 16); // of the window, on every screen: in its middle

enum Button { walkAbout, minimise, close, none };

struct Looks {
    bool active = true;
    bool walking = false; // which disables all buttons but the last
    Button pressed = none;
    int quarters = 0;  // of the show
    bool over = false; // and it has come to its end
};

class Chrome : public Run, public testing::WithParamInterface<QSize> {
  protected:
    Chrome() : Run(GetParam()) {}

    /// Finds a window that shows, by its title, and does something with it.
    bool window(const std::string& name, const std::string& what = "getwindowname") {
        return ground.command({"xdotool", "search", "--onlyvisible", "--name", name, what}) == 0;
    }

    void mouse(QPoint at, const std::vector<std::string>& then = {}) const {
        std::vector<std::string> words{"xdotool", "mousemove", std::to_string(at.x()),
                                       std::to_string(at.y())};
        words.insert(words.end(), then.begin(), then.end());
        ground.command(words);
    }

    void click(Button button) const {
        mouse(client.topLeft() + sysButton(button).center(), {"click", "1"});
    }

    /// By its caption, as slowly as the window manager follows.
    void drag(QPoint by, const Looks& looks) {
        const QPoint grip = client.topLeft() + QPoint(60, 10);
        mouse(grip, {"mousedown", "1"});
        client.translate(by);
        const auto follows = [&] {
            mouse(grip + by / 2);
            mouse(grip + by);
            const QImage shown = ground.grab();
            return difference(sketchOf(looks, barEnds(shown)), shown).empty();
        };
        EXPECT_TRUE(waitFor(follows)) << "dragged";
        ground.command({"xdotool", "mouseup", "1"});
    }

    void activate(const std::string& name) {
        ASSERT_TRUE(waitFor([&] { return window(name, "windowactivate"); }));
    }

    void openEditor() {
        // The first keys may come before the dialog is there and has the keyboard.
        ASSERT_TRUE(waitFor(
            [&] {
                ground.press("alt+e");
                return waitFor([&] { return window(title); }, 2);
            },
            60));
    }

    /// Opens the first four frames of a Toon, with pauses of a second.
    void openShortToon() {
        std::ifstream whole(DORBO_TOONS "/counting.zkt", std::ios::binary);
        std::string toon(104 + 4 * 92, '\0');
        whole.read(toon.data(), static_cast<std::streamsize>(toon.size()));
        for (std::size_t frame = 104; frame < toon.size(); frame += 92) {
            toon[frame + 12] = 1;
        }
        std::ofstream(ground.toons() / "short.zkt", std::ios::binary) << toon;
        ground.press("ctrl+o");
        expect({.active = false}, "behind a dialog");
        ground.typeInto("Open Toon File", "short.zkt");
    }

    QRect sysButton(Button button) const {
        const int lefts[] = {10, client.width() - 40, client.width() - 25};
        return {lefts[button], 4, button == walkAbout ? 32 : 15, 15};
    }

    /// Presses a button and lets go of it elsewhere.
    void press(Button button, Looks looks) {
        const QPoint at = client.topLeft() + sysButton(button).center();
        mouse(at, {"mousedown", "1"});
        looks.pressed = button;
        expect(looks, "pressed");
        ground.command({"xdotool", "mousemove_relative", "0", "60", "mouseup", "1"});
        looks.pressed = none;
        expect(looks, "let go of");
    }

    /// Where the caption's bars end and begin on the left and on the right of its text.
    std::pair<int, int> barEnds(const QImage& shown) const {
        const auto isEdge = [&](int x) {
            return shown.pixel(client.topLeft() + QPoint(x, 3)) == dark;
        };
        int left = 44;
        int right = client.width() - 44;
        for (; left < right && isEdge(left); ++left) {
        }
        for (; left < right && isEdge(right - 1); --right) {
        }
        return {left + 1, right};
    }

    void drawSysButton(QPainter& sketch, Button button, const Looks& looks) const {
        constexpr int sources[] = {20, 0, 11};
        const QRect place = sysButton(button);
        const bool pressed = looks.pressed == button;
        const QRect picture = place.adjusted(pressed ? 3 : 2, pressed ? 3 : 2, -2, -2);
        bevel(sketch, place, pressed ? 2 : looks.walking && button != close ? 1 : -2);
        sketch.drawImage(picture.topLeft(), sysButtons,
                         QRect(QPoint(sources[button], 0), picture.size()));
    }

    void drawCaption(QPainter& sketch, const Looks& looks, std::pair<int, int> ends) const {
        const int right = client.width();
        bevel(sketch, edges(8, 3, 43, 20), 1);
        bevel(sketch, edges(right - 42, 3, right - 8, 20), 1);
        const QRgb colour = looks.active ? blue : face;
        box(sketch, edges(44, 3, ends.first, 20), 1, colour);
        box(sketch, edges(ends.second, 3, right - 43, 20), 1, colour);
        sketch.fillRect(edges(ends.first + 4, 2, ends.second - 5, 22), anything); // shadow and text
        for (const Button button : {walkAbout, minimise, close}) {
            drawSysButton(sketch, button, looks);
        }
    }

    /// What the screen should show.
    QImage sketchOf(const Looks& looks, std::pair<int, int> ends) const {
        const int right = client.width();
        const int bottom = client.height();
        QImage picture(GetParam(), QImage::Format_ARGB32);
        picture.fill(anything);
        QPainter sketch(&picture);
        sketch.setCompositionMode(QPainter::CompositionMode_Source);
        sketch.translate(client.topLeft());
        sketch.fillRect(edges(-1, -1, right + 1, bottom + 1), QColor(black));
        sketch.fillRect(edges(0, 0, right, bottom), QColor(face));
        bevel(sketch, edges(0, 0, right, bottom), -2);
        bevel(sketch, edges(8, 23, right - 8, bottom - 38), 2);
        sketch.fillRect(edges(10, 25, right - 10, bottom - 40), anything); // the stage
        for (const int left : {8, right - 87}) {
            bevel(sketch, edges(left, bottom - 34, left + 79, bottom - 7), 2);
            pushButton(sketch, QRect(left + 2, bottom - 32, 75, 23));
        }
        for (int quarter = 0; quarter <= looks.quarters; ++quarter) { // each over the one before
            const int done = 92 + (right - 184) * quarter / 4;
            box(sketch, edges(done, bottom - 31, right - 92, bottom - 12), 2, face);
            box(sketch, edges(92, bottom - 31, done, bottom - 12), -1, blue);
        }
        if (looks.over) {
            box(sketch, edges(92, bottom - 31, right - 92, bottom - 12), 2, face);
        }
        drawCaption(sketch, looks, ends);
        return picture;
    }

    void expect(const Looks& looks, const char* when) {
        std::string wrong;
        const auto asDrawn = [&] {
            const QImage shown = ground.grab();
            wrong = difference(sketchOf(looks, barEnds(shown)), shown);
            return wrong.empty();
        };
        EXPECT_TRUE(waitFor(asDrawn, 30)) << when << ": " << wrong;
    }

    const QImage sysButtons = loadPicture("sysbuts");
    QRect client{corner + QPoint(1, 1),
                 GetParam() - QSize(50, 100) + QSize(20, 65)}; // stage and what is round it
};

TEST_P(Chrome, LooksAsDrawn) {
    auto setup = ground.start({"C"});
    openEditor();
    if (HasFatalFailure()) {
        return;
    }
    expect({}, "at first");
    const QImage first = ground.grab();
    const std::pair ends = barEnds(first);
    const auto [left, right] = ends;
    const int textWidth = right - left - 10;
    EXPECT_EQ(left, 8 + (client.width() - 16 - textWidth - 10) / 2) << "in the middle";
    const QImage text = first.copy(edges(left + 5, 2, right - 5, 22).translated(client.topLeft()));
    EXPECT_EQ(coloursOf(text), (std::set<QRgb>{black, dark, light, face}));
    expect({.walking = true}, "while he says hello");
    press(close, {.walking = true});
    activate("Rematch");
    expect({.active = false, .walking = true}, "inactive");
    activate(title);
    expect({.walking = true}, "active again");
    if (GetParam().width() == 640) { // where he has soon gone again
        expect({}, "at rest");
        press(walkAbout, {});
        press(minimise, {});
        openShortToon();
        const auto opened = [&] { return barEnds(ground.grab()) != ends; };
        ASSERT_TRUE(waitFor(opened)) << "it has a caption of its own";
        expect({}, "nothing walked");
        ground.press("alt+p");
        for (const int quarters : {1, 2, 3, 4}) {
            expect({.walking = true, .quarters = quarters}, "at a frame");
        }
        const Looks rest{.quarters = 4, .over = true};
        expect(rest, "he has gone again");
        click(minimise);
        EXPECT_TRUE(waitFor([&] { return !window(title); })) << "minimised";
        ground.command({"xdotool", "search", "--name", title, "windowactivate"});
        expect(rest, "back again");
        drag({-9, 12}, rest);
        click(close);
        EXPECT_TRUE(waitFor([&] { return !window(title); })) << "closed";
    }
}

INSTANTIATE_TEST_SUITE_P(Screens, Chrome,
                         testing::Values(QSize(640, 480), QSize(1024, 768), QSize(1920, 1080)));

} // namespace
