// Keys and mouse events in the order of the messages that they bring about.
//
// The toolkit hands over at one go whatever has come in, be it ten keys that were pressed while the
// machine was busy. What the program does with the first decides where the second belongs: which
// field is filled, which window is open. So what the user does waits here until the program has
// taken the messages queued before it. In a loop of the toolkit's own
// (a box, a menu) it waits only once that has been answered and the loop is about to end. Keys also
// wait for a window of ours that is about to get the keyboard.
//
// One thing comes out of order all the same: a character that the toolkit composes of several keys
// is ready before the keys that came in at one go with them.
#pragma once

#include <QApplication>

namespace seam {

class OrderedApplication : public QApplication {
  public:
    using QApplication::QApplication;

    bool notify(QObject* receiver, QEvent* event) override;
};

/// Hands over the first event that waits: a key to whoever has the keyboard by now, anything else
/// to its window unless a box bars that. False if none waits, or if it goes on waiting for the
/// keyboard.
bool handOverInput();

} // namespace seam
