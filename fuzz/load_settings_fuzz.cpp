// An option set loaded into the settings window: any bytes as a .lum file, through
// frmSettings::LoadSettings into the window's options and controls. One window serves every input;
// before each one it is put back into its start state, so a finding replays from its file alone.
#include "FuzzSupport.h"

#include "emulator/OptionFile.h"
#include "emulator/Switches.h"
#include "platform/Dialogs.h"
#include "platform/Downloader.h"
#include "platform/Platform.h"
#include "platform/Registry.h"
#include "platform/SettingsStore.h"
#include "platform/Shell.h"
#include "settings/frmSettings.h"

#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QTemporaryDir>

#include <algorithm>
#include <cstdlib>
#include <map>
#include <utility>

namespace {

// The settings store, in memory only: nothing of a fuzzing run reaches the user's own.
class MemoryStore final : public SettingsStore {
public:
    QString GetSetting(const QString& section, const QString& key,
                       const QString& def) const override {
        const auto it = m_values.find(address(section, key));
        return it == m_values.end() ? def : it->second;
    }
    bool SaveSetting(const QString& section, const QString& key, const QString& value) override {
        m_values[address(section, key)] = value;
        return true;
    }
    bool DeleteSetting(const QString& section, const QString& key) override {
        m_values.erase(address(section, key));
        return true;
    }

private:
    static std::pair<QString, QString> address(const QString& section, const QString& key) {
        return {section.toLower(), key.toLower()};
    }
    std::map<std::pair<QString, QString>, QString> m_values;
};

// Message boxes are counted and answered with their first button; a save is given
// `savePath`, every other chooser is cancelled.
class CountingDialogs final : public Dialogs {
public:
    MsgResult MsgBox(QWidget*, const QString&, MsgButtons buttons, MsgIcon,
                     const QString&) override {
        ++boxes;
        return buttons == MsgButtons::YesNo || buttons == MsgButtons::YesNoCancel ? MsgResult::Yes
                                                                                  : MsgResult::Ok;
    }
    QString ShowOpen(QWidget*, const FileDialogRequest&) override { return QString(); }
    QString ShowSave(QWidget*, const FileDialogRequest&) override { return savePath; }
    QString ShowFolder(QWidget*, const QString&, const QString&) override { return QString(); }
    std::optional<quint32> ShowColor(QWidget*, const QString&, quint32) override {
        return std::nullopt;
    }

    int boxes = 0;
    QString savePath;
};

class NoShell final : public Shell {
public:
    bool StartProgram(const QString&, const QStringList&, const QString&, QString*) override {
        return false;
    }
    bool OpenUrl(const QString&) override { return false; }
    bool OpenTextFile(const QString&) override { return false; }
    bool OpenFolder(const QString&) override { return false; }
};

class NoNetwork final : public Downloader {
public:
    using Downloader::DownloadFile;
    bool DownloadFile(const QString&, const QString&, const DownloadWatch&) override {
        return false;
    }
};

class NoRegistry final : public Registry {
public:
    std::optional<RegistryValue> QueryValue(quint32, const QString&, const QString&) override {
        return std::nullopt;
    }
};

struct Harness {
    QTemporaryDir dir;
    MemoryStore store;
    CountingDialogs dialogs;
    NoShell shell;
    NoNetwork network;
    NoRegistry registry;
    Platform platform{store,    dialogs,    shell,      dir.path(), network,
                      registry, dir.path(), dir.path(), dir.path(), dir.path()};
    frmSettings window{platform};
    QString startState = dir.filePath(QStringLiteral("start.lum"));
    QString input = dir.filePath(QStringLiteral("input.lum"));
};

Harness* harness = nullptr;

QString preview(const frmSettings& w) {
    return w.findChild<QLabel*>(QStringLiteral("lblDOSOutput"))->text();
}

void checkWindow(frmSettings& w) {
    for (const char* name :
         {"comboVideoMode", "comboLeftController", "comboRightController", "comboGT"}) {
        const auto* list = w.findChild<QComboBox*>(QLatin1String(name));
        FUZZ_CHECK(list->currentIndex() >= -1 && list->currentIndex() < list->count());
    }
    // The sliders are not checked against their scales: like the user's own bars, they
    // take any whole value. The preview shows the options as they now are.
    FUZZ_CHECK(preview(w) == launchSwitches(w.options()).mid(1));
}

bool writeFile(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    return file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size();
}

} // namespace

// fontconfig, below Qt's text drawing, keeps a cache that it never frees; not ours to report.
extern "C" const char* __lsan_default_suppressions() {
    return "leak:libfontconfig.so\n";
}

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    // Qt may take arguments it knows out of the list; libFuzzer's own stay untouched.
    static int qtArgc = 1;
    static char* qtArgv[] = {(*argv)[0], nullptr};
    (void)argc;
    // Both live until the process ends and are never destroyed: Qt's own clean-up at exit
    // would otherwise run after parts of Qt it needs are gone.
    new QApplication(qtArgc, qtArgv);
    harness = new Harness;
    FUZZ_CHECK(harness->dir.isValid());
    // The harness is never destroyed, so its temporary folder goes at exit by hand.
    std::atexit([] { QDir(harness->dir.path()).removeRecursively(); });
    // The window's start state, saved by its own Save button, is what every input starts
    // from.
    harness->dialogs.savePath = harness->startState;
    harness->window.cmdSaveDat_Click();
    FUZZ_CHECK(QFile::exists(harness->startState));
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Harness& h = *harness;
    frmSettings& w = h.window;
    const QByteArray bytes = fuzz::bytes(data, size);
    FUZZ_CHECK(writeFile(h.input, bytes));

    FUZZ_CHECK(w.LoadSettings(h.startState));
    const QString startPreview = preview(w);

    // True exactly when the set decodes whole; a failure says so once.
    const bool ok = decodeOptions(bytes, w.options()).ok();
    const int boxesBefore = h.dialogs.boxes;
    const bool loaded = w.LoadSettings(h.input);
    FUZZ_CHECK(loaded == ok);
    FUZZ_CHECK(h.dialogs.boxes - boxesBefore == (ok ? 0 : 1));
    checkWindow(w);
    const QString shown = preview(w);

    // The same bytes again change nothing more.
    FUZZ_CHECK(w.LoadSettings(h.input) == loaded);
    FUZZ_CHECK(preview(w) == shown);
    checkWindow(w);

    // A set that loaded saves to one that loads to the same preview.
    if (loaded) {
        h.dialogs.savePath = h.dir.filePath(QStringLiteral("saved.lum"));
        w.cmdSaveDat_Click();
        FUZZ_CHECK(w.LoadSettings(h.startState));
        FUZZ_CHECK(preview(w) == startPreview);
        FUZZ_CHECK(w.LoadSettings(h.dialogs.savePath));
        FUZZ_CHECK(preview(w) == shown);
    }
    return 0;
}
