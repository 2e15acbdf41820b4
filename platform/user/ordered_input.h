// Keys and mouse events in the order of the messages that they bring about.
//
// The toolkit hands over at one go whatever has come in, be it ten keys that were pressed while the
// machine was busy. What the program does with the first decides where the second belongs: which
// field is filled, which window is open. So a key or a mouse event waits here until the program has
// taken the messages queued before it. Loops of the toolkit's own (boxes, menus) order theirs.
#pragma once

#include <QApplication>

namespace seam {

class OrderedApplication : public QApplication {
  public:
    using QApplication::QApplication;

    bool notify(QObject* receiver, QEvent* event) override;
};

/// Hands over the first event that waits, to the window that it is for by now; false if none does.
bool handOverInput();

} // namespace seam
