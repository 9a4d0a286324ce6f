// Start-up: from process start to the first paint of the main window with its list filled,
// for 10,000 and 100,000 ROMs, against a Qt program that shows a window with one line of text
// (and one that shows an empty window) and quits
// at its first paint; and the peak memory of each. Every run is a fresh process (this
// program started again in a child mode), timed and measured by the parent.

#include "BenchReport.h"

#include "app/frmMain.h"
#include "library/RomListModel.h"
#include "platform/Downloader.h"
#include "platform/IniSettingsStore.h"
#include "platform/Platform.h"
#include "platform/QtDialogs.h"
#include "platform/QtShell.h"
#include "platform/Registry.h"

#include <QApplication>
#include <QDir>
#include <QEvent>
#include <QFile>
#include <QLabel>
#include <QWidget>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include <dirent.h>
#include <fcntl.h>
#include <fnmatch.h>
#include <spawn.h>
#include <strings.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace {

using Clock = std::chrono::steady_clock;

// With LUM_BENCH_PHASES set, a child prints how long each step of its start took.
class Phases {
public:
    void operator()(const char* what) const {
        if (m_on)
            std::fprintf(stderr, "%-8s %7.1f ms\n", what,
                         std::chrono::duration<double, std::milli>(Clock::now() - m_start).count());
    }

private:
    Clock::time_point m_start = Clock::now();
    bool m_on = std::getenv("LUM_BENCH_PHASES") != nullptr;
};

// Ends the process at the first paint of the watched window.
class FirstPaint : public QObject {
public:
    explicit FirstPaint(const Phases* phases = nullptr) : m_phases(phases) {}
    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Paint) {
            if (m_phases)
                (*m_phases)("paint");
            std::fflush(stdout);
            std::fflush(stderr);
            _exit(0);
        }
        return false;
    }

private:
    const Phases* m_phases;
};

// withText: a line of text in the window, so that the font system starts as it must for
// any window with a caption or a list in it.
int runMinimal(int argc, char** argv, bool withText) {
    QApplication app(argc, argv);
    QWidget window;
    FirstPaint watcher;
    window.installEventFilter(&watcher);
    window.resize(327, 438);
    if (withText)
        (new QLabel(QStringLiteral("lum - 10000 ROM's Found"), &window))->move(8, 8);
    window.show();
    return QApplication::exec();
}

int runLum(int argc, char** argv, const char* configFile) {
    const Phases phase;
    QApplication app(argc, argv);
    phase("app");
    IniSettingsStore store(QString::fromLocal8Bit(configFile));
    QtDialogs dialogs;
    QtShell shell;
    QtDownloader network;
    ToolRegistry registry;
    const QString here = QApplication::applicationDirPath();
    Platform platform{store, dialogs, shell, here, network, registry, here, here, here, here};
    frmMain window(platform);
    phase("windows");
    FirstPaint watcher(&phase);
    // The load handler shows the window and lets one paint through before it fills the
    // list; the paint that counts is the first one after the fill.
    window.Form_Load();
    phase("load");
    window.installEventFilter(&watcher);
    window.show();
    window.update();
    return QApplication::exec();
}

void makeFolder(const std::string& folder, int count) {
    const std::string done = folder + "/.complete";
    if (access(done.c_str(), F_OK) == 0)
        return;
    QDir().mkpath(QString::fromStdString(folder));
    for (int i = 0; i < count; ++i) {
        const std::string name = folder + "/Game " + std::to_string(i) + ".bin";
        close(open(name.c_str(), O_CREAT | O_WRONLY, 0644));
    }
    close(open(done.c_str(), O_CREAT | O_WRONLY, 0644));
}

std::string writeConfig(const std::string& root, const std::string& folder, int count) {
    const std::string path = root + "/startup-" + std::to_string(count) + ".ini";
    FILE* f = std::fopen(path.c_str(), "w");
    std::fprintf(f, "[Settings]\nZ26Path=%s\nROMPath=%s\nROMChecked=True\nROMFilter=*.bin\n",
                 root.c_str(), folder.c_str());
    std::fclose(f);
    return path;
}

struct Run {
    double ms;
    long maxRssKb;
};

Run spawnChild(const char* self, const std::vector<const char*>& args) {
    std::vector<char*> argv{const_cast<char*>(self)};
    for (const char* a : args)
        argv.push_back(const_cast<char*>(a));
    argv.push_back(nullptr);
    // Qt's warnings about the offscreen platform would bury the report.
    posix_spawn_file_actions_t quiet;
    posix_spawn_file_actions_init(&quiet);
    posix_spawn_file_actions_addopen(&quiet, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    const auto start = std::chrono::steady_clock::now();
    pid_t pid = 0;
    const int spawned = posix_spawn(&pid, self, &quiet, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&quiet);
    if (spawned != 0) {
        std::fprintf(stderr, "could not start %s: %s\n", self, std::strerror(spawned));
        std::exit(1);
    }
    int status = 0;
    rusage usage{};
    wait4(pid, &status, 0, &usage);
    const auto end = std::chrono::steady_clock::now();
    if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
        std::fprintf(stderr, "%s %s did not start cleanly (status %d); run it by hand to see why\n",
                     self, args.empty() ? "" : args[0], status);
        std::exit(1);
    }
    return {std::chrono::duration<double, std::milli>(end - start).count(), usage.ru_maxrss};
}

size_t readdirBaseline(const std::string& folder) {
    std::vector<std::string> names;
    DIR* dir = opendir(folder.c_str());
    while (const dirent* e = readdir(dir))
        if (e->d_name[0] != '.' && e->d_type == DT_REG &&
            fnmatch("*.bin", e->d_name, FNM_CASEFOLD) == 0)
            names.emplace_back(e->d_name);
    closedir(dir);
    std::sort(names.begin(), names.end(), [](const std::string& a, const std::string& b) {
        return strcasecmp(a.c_str(), b.c_str()) < 0;
    });
    return names.size();
}

} // namespace

int main(int argc, char** argv) {
    if (argc >= 2 && std::strcmp(argv[1], "--minimal") == 0)
        return runMinimal(argc, argv, false);
    if (argc >= 2 && std::strcmp(argv[1], "--minimal-text") == 0)
        return runMinimal(argc, argv, true);
    if (argc >= 3 && std::strcmp(argv[1], "--lum") == 0)
        return runLum(argc, argv, argv[2]);

    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    const std::string root = "/tmp/lum-bench-startup";
    const std::string self = "/proc/self/exe";
    char exe[4096] = {};
    const ssize_t n = readlink(self.c_str(), exe, sizeof exe - 1);
    if (n <= 0)
        return 1;

    for (int count : {10000, 100000})
        makeFolder(root + "/roms-" + std::to_string(count), count);
    const std::string config10k = writeConfig(root, root + "/roms-10000", 10000);
    const std::string config100k = writeConfig(root, root + "/roms-100000", 100000);

    // The programs take turns, so that a busy machine slows each alike.
    struct Series {
        std::vector<const char*> args;
        bench::Samples time;
        std::vector<long> rss;
        double medianRssMb() const {
            std::vector<long> sorted = rss;
            std::sort(sorted.begin(), sorted.end());
            return sorted[sorted.size() / 2] / 1024.0;
        }
    };
    Series floor{{"--minimal"}, {}, {}};
    Series textFloor{{"--minimal-text"}, {}, {}};
    Series ours10k{{"--lum", config10k.c_str()}, {}, {}};
    Series ours100k{{"--lum", config100k.c_str()}, {}, {}};
    Series* all[] = {&floor, &textFloor, &ours10k, &ours100k};
    constexpr int kRuns = 11;
    for (int i = -1; i < kRuns; ++i) {
        for (Series* series : all) {
            const Run r = spawnChild(exe, series->args);
            if (i < 0)
                continue; // the first round warms the caches
            series->time.ms.push_back(r.ms);
            series->rss.push_back(r.maxRssKb);
        }
    }

    // Against a window that draws one line of text: the minimal program draws none, so it
    // never starts the font system, whose start alone uses up most of a 1.5 x margin.
    bench::report("start-up, 10000 ROMs", ours10k.time, "one line of text", textFloor.time, 1.5);
    std::printf("   (for reference: the minimal program starts in %.1f ms; ours is %.2f x that)\n",
                floor.time.median(), ours10k.time.median() / floor.time.median());

    const bench::Samples readdir =
        bench::measure(kRuns, [&] { readdirBaseline(root + "/roms-100000"); });
    const double limit = 1.5 * floor.time.median() + readdir.median();
    bench::report("start-up, 100000 ROMs", ours100k.time, "minimal Qt", floor.time,
                  limit / floor.time.median());
    std::printf("   (aim: under 1.5 x floor + readdir %.1f ms = %.1f ms)\n", readdir.median(),
                limit);

    const double above = ours100k.medianRssMb() - floor.medianRssMb();
    std::printf("%-34s ours %9.1f MB | minimal Qt %9.1f MB | %.1f MB above | aim < 40 MB above "
                "%s\n",
                "peak memory, 100,000 rows", ours100k.medianRssMb(), floor.medianRssMb(), above,
                above < 40 ? "met" : "MISSED");
    return 0;
}
