#pragma once

#include "common/Status.h"

#include <QString>
#include <memory>

namespace zorbin {

// Opens a local file in a new, separate browser window that the user then owns.
class Browser
{
public:
    virtual ~Browser() = default;
    virtual Status openWindow(const QString &file) = 0;
};

// The browser of this machine. A Chromium-family browser is started in app mode, which shows
// the page without an address bar; otherwise the desktop's handler for the file opens it.
// The environment variable ZORBIN_BROWSER, when set, names the program to start instead
// (it gets the file's URL as its one argument).
std::unique_ptr<Browser> makeSystemBrowser();

} // namespace zorbin
