#pragma once

#include "support/FakePlatform.h"
#include "support/QtPrinters.h"

#include <string>
#include <vector>

// A message box as one line, "title | text | buttons | icon", so that a test checks all
// four in one comparison and a failure shows the whole box.
inline std::string boxLine(const FakeDialogs::Box& box) {
    static const char* const buttons[] = {"Ok", "OkCancel", "YesNo", "YesNoCancel"};
    static const char* const icons[] = {"None", "Critical", "Question", "Exclamation",
                                        "Information"};
    return (box.title + " | " + box.text).toStdString() + " | " +
           buttons[static_cast<int>(box.buttons)] + " | " + icons[static_cast<int>(box.icon)];
}

// Every box shown so far, in order.
inline std::vector<std::string> boxLines(const FakeDialogs& dialogs) {
    std::vector<std::string> lines;
    for (const FakeDialogs::Box& box : dialogs.boxes)
        lines.push_back(boxLine(box));
    return lines;
}

// Every file chooser asked for so far, one line each: "open|save | title | filter |
// folder | filter index | flags in hex".
inline std::vector<std::string> requestLines(const FakeDialogs& dialogs) {
    std::vector<std::string> lines;
    for (const auto& [bSave, r] : dialogs.fileRequests)
        lines.push_back(QStringList({bSave ? "save" : "open", r.title, r.filter, r.initialFolder,
                                     QString::number(r.filterIndex), QString::number(r.flags, 16)})
                            .join(" | ")
                            .toStdString());
    return lines;
}

// The expected lines, written as a list of texts.
using Lines = std::vector<std::string>;
