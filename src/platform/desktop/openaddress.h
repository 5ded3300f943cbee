#pragma once

#include <QString>
#include <functional>

/// Gives an address to the desktop's own program for that, which finds the browser. Returns at
/// once; notOpened is called from the event loop when no browser was found. The browser is no child
/// of the program and stays when that ends.
void openInBrowser(const QString &url, const std::function<void()> &notOpened);
