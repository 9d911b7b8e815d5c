// The "Commande : " prompt of pyralis as a person uses it at a terminal: the program runs on a
// pseudo-terminal, the test types keys and reads the screen. Every read has a deadline, generous for a
// build with sanitizers: a program that stops answering fails the test, it never hangs it.
#include "HostTestSupport.h"

#include <chrono>
#include <csignal>
#include <poll.h>
#include <pty.h>
#include <thread>

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;

constexpr auto kPatience = std::chrono::seconds(90);

constexpr const char* kEnter = "\r";
constexpr const char* kEscape = "\x1b";
constexpr const char* kCtrlC = "\x03";
constexpr const char* kCtrlD = "\x04";
constexpr const char* kUp = "\x1b[A";
constexpr const char* kPrompt = "Commande : ";

// pyralis on a pseudo-terminal of its own, run from a folder with its own parameter file and its own
// configuration folder.
class Terminal {
public:
    Terminal(const TempDir& dir, const std::vector<std::string>& arguments) {
        std::vector<std::string> words{ProgramFile("pyralis"), "--params", dir / "Pyralis.ini"};
        words.insert(words.end(), arguments.begin(), arguments.end());
        std::vector<char*> argv;
        for (std::string& word : words)
            argv.push_back(word.data());
        argv.push_back(nullptr);
        const std::string folder = dir.Root().string(), config = dir / "config";
        winsize size{40, 200, 0, 0};
        m_pid = forkpty(&m_master, nullptr, nullptr, &size);
        if (m_pid == 0) {
            if (chdir(folder.c_str()) != 0) _exit(127);
            setenv("XDG_CONFIG_HOME", config.c_str(), 1);
            setenv("TERM", "vt100", 1);
            setenv("VISUAL", "true", 1); // a listing shown is closed at once
            execv(argv[0], argv.data());
            _exit(127);
        }
    }
    ~Terminal() {
        if (m_pid > 0) {
            kill(m_pid, SIGKILL);
            waitpid(m_pid, nullptr, 0);
        }
        if (m_master >= 0) close(m_master);
    }
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    pid_t Pid() const { return m_pid; }

    // Reads until `text` comes after what the earlier waits found; false when it has not come by the
    // deadline or when the program ended without writing it.
    bool WaitFor(std::string_view text) {
        const auto deadline = Clock::now() + kPatience;
        while (true) {
            const std::size_t found = m_screen.find(text, m_seen);
            if (found != std::string::npos) {
                m_seen = found + text.size();
                return true;
            }
            if (!ReadSome(deadline)) return false;
        }
    }
    void Type(std::string_view keys) {
        ASSERT_EQ(write(m_master, keys.data(), keys.size()), ssize_t(keys.size()));
    }
    // Types `keys` (none when empty), then waits for `text`; a failure shows the screen.
    ::testing::AssertionResult Shows(std::string_view keys, std::string_view text) {
        if (!keys.empty()) Type(keys);
        if (WaitFor(text)) return ::testing::AssertionSuccess();
        return ::testing::AssertionFailure() << "« " << text << " » not shown after « " << keys << " »:\n"
                                             << m_screen;
    }

    // The program's exit status once it has ended (what it still writes is read meanwhile), -1 when it does
    // not end by the deadline.
    int Status() {
        const auto deadline = Clock::now() + kPatience;
        while (Clock::now() < deadline) {
            int raw = 0;
            if (waitpid(m_pid, &raw, WNOHANG) == m_pid) {
                m_pid = -1;
                return WIFEXITED(raw) ? WEXITSTATUS(raw) : 128 + WTERMSIG(raw);
            }
            if (!ReadSome(Clock::now() + std::chrono::milliseconds(50)))
                std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        return -1;
    }
    // Everything the program wrote, for the messages of failed expectations.
    const std::string& Screen() const { return m_screen; }

private:
    bool ReadSome(Clock::time_point deadline) {
        while (true) {
            const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
            if (left.count() <= 0) return false;
            pollfd master = {m_master, POLLIN, 0};
            const int ready = poll(&master, 1, static_cast<int>(left.count()));
            if (ready < 0 && errno == EINTR) continue;
            if (ready <= 0) return false;
            char bytes[4096];
            const ssize_t n = read(m_master, bytes, sizeof bytes);
            if (n <= 0) return false; // the program ended: the terminal is closed
            m_screen.append(bytes, static_cast<std::size_t>(n));
            return true;
        }
    }

    pid_t m_pid = -1;
    int m_master = -1;
    std::string m_screen;
    std::size_t m_seen = 0;
};

class Prompt : public PyralisTest {
protected:
    void SetUp() override {
        original = Demo("demo.geo");
        fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/carnet-tilleuls.qdl", dir / "carnet.qdl");
    }
    std::string Geo() const { return dir / "demo.geo"; }
    std::string History() const { return dir / "config/pyralis/historique.txt"; }
    // The files of the folder, the configuration folder aside: a temporary file left behind shows here.
    std::vector<std::string> Files() const {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(dir.Root()))
            if (entry.path().filename() != "config") names.push_back(entry.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }

    std::string original;
    // Reading the field book into a GéoBase that is not empty asks first: add to it (Oui), make a new one
    // (Non), or give up (Annuler, the default).
    const std::string readFieldBook = "GeoEdit demo.geo --lecture Quendal-Pc carnet.qdl";
    // The GéoBase opened becomes the last one used, in the parameter file, before the question.
    const std::vector<std::string> untouched{"Pyralis.ini", "carnet.qdl", "demo.geo"};
};

TEST_F(Prompt, ACommandTypedRunsAndEnterOnAnEmptyLineRunsItAgain) {
    const std::string shown = "Barre d'outils « Calculs Topo » affichée.";
    {
        Terminal terminal(dir, {});
        ASSERT_TRUE(terminal.Shows("", kPrompt));
        ASSERT_TRUE(terminal.Shows(std::string("pyrcaltopo15") + kEnter, shown));
        ASSERT_TRUE(terminal.Shows("", kPrompt));
        ASSERT_TRUE(terminal.Shows(kEnter, shown)) << "run again";
        ASSERT_TRUE(terminal.Shows("", kPrompt));
        // Tab completes a command's name.
        ASSERT_TRUE(terminal.Shows(std::string("CalcO\t--afficher") + kEnter, "RayonTerre="));
        ASSERT_TRUE(terminal.Shows("", kPrompt));
        terminal.Type(std::string("FIN") + kEnter);
        EXPECT_EQ(terminal.Status(), 0) << terminal.Screen();
    }
    // Each command line once, in the order typed; the line run again is not repeated.
    EXPECT_EQ(ReadBytes(History()), "pyrcaltopo15\nCalcOpt --afficher\n");

    // The next session finds the commands of the earlier one: Up twice, then Enter.
    Terminal next(dir, {});
    ASSERT_TRUE(next.Shows("", kPrompt));
    ASSERT_TRUE(next.Shows(std::string(kUp) + kUp + kEnter, shown));
    ASSERT_TRUE(next.Shows("", kPrompt));
    // Ctrl-D on an empty line ends the session.
    next.Type(kCtrlD);
    EXPECT_EQ(next.Status(), 0) << next.Screen();
}

TEST_F(Prompt, CtrlCAtAQuestionCancelsTheCommandAndLeavesTheGeoBaseAsItWas) {
    Terminal terminal(dir, {});
    ASSERT_TRUE(terminal.Shows("", kPrompt));
    // Ctrl-C on a line being typed cancels the line alone.
    terminal.Type("CalInter --bidon");
    ASSERT_TRUE(terminal.Shows(kCtrlC, "*Annulé*"));
    ASSERT_TRUE(terminal.Shows("", kPrompt));

    ASSERT_TRUE(terminal.Shows(readFieldBook + kEnter, "(o)ui / (n)on / (a)nnuler [Annuler] ? "));
    ASSERT_TRUE(terminal.Shows(kCtrlC, "*Annulé*"));
    ASSERT_TRUE(terminal.Shows("", kPrompt));
    EXPECT_EQ(ReadBytes(Geo()), original);
    EXPECT_EQ(Files(), untouched);

    // The prompt goes on as before: the same command, answered this time.
    ASSERT_TRUE(terminal.Shows(kEnter, "(a)nnuler [Annuler] ? "));
    ASSERT_TRUE(terminal.Shows(std::string("o") + kEnter, kPrompt));
    EXPECT_GT(ReadBytes(Geo()).size(), original.size()) << "the field book added: " << terminal.Screen();
    terminal.Type(std::string("FIN") + kEnter);
    EXPECT_EQ(terminal.Status(), 0) << terminal.Screen();
}

TEST_F(Prompt, EscapeCancelsAQuestionAndCtrlDTakesItsDefault) {
    Terminal terminal(dir, {});
    ASSERT_TRUE(terminal.Shows("", kPrompt));
    // Escape at the prompt abandons the line.
    terminal.Type("GeoEdit");
    ASSERT_TRUE(terminal.Shows(kEscape, "*Annulé*"));
    ASSERT_TRUE(terminal.Shows("", kPrompt));

    // A yes/no/cancel question: Escape answers Cancel, though Oui is typed after it.
    ASSERT_TRUE(terminal.Shows(readFieldBook + kEnter, "[Annuler] ? "));
    ASSERT_TRUE(terminal.Shows(std::string("o") + kEscape, "Réponse : Annuler"));
    ASSERT_TRUE(terminal.Shows("", kPrompt));
    EXPECT_EQ(ReadBytes(Geo()), original);
    EXPECT_EQ(Files(), untouched);

    // Non asks for a new GéoBase, named after the field book; as one of that name exists, whether to
    // replace it, Non by default, which Ctrl-D takes.
    WriteBytes(dir / "carnet.geo", "à garder\n");
    ASSERT_TRUE(terminal.Shows(readFieldBook + kEnter, "[Annuler] ? "));
    ASSERT_TRUE(terminal.Shows(std::string("n") + kEnter, "(o)ui / (n)on [Non] ? "));
    ASSERT_TRUE(terminal.Shows(kCtrlD, "Réponse : Non"));
    ASSERT_TRUE(terminal.Shows("", kPrompt));
    EXPECT_EQ(ReadBytes(dir / "carnet.geo"), "à garder\n") << "not replaced";
    EXPECT_EQ(ReadBytes(Geo()), original);
    terminal.Type(kCtrlD);
    EXPECT_EQ(terminal.Status(), 0) << terminal.Screen();
}

// Without the prompt, an interrupted command ends pyralis with the status of its signal, and what it was
// writing stays as it was.
TEST_F(Prompt, WithoutThePromptCtrlCAndSigtermEndTheProgram) {
    for (const auto& [signal, status] : {std::pair{SIGINT, 130}, {SIGTERM, 143}}) {
        Terminal terminal(dir, {"GeoEdit", "demo.geo", "--lecture", "Quendal-Pc", "carnet.qdl"});
        ASSERT_TRUE(terminal.Shows("", "[Annuler] ? "));
        if (signal == SIGINT)
            terminal.Type(kCtrlC); // the terminal sends it
        else
            kill(terminal.Pid(), SIGTERM);
        EXPECT_EQ(terminal.Status(), status) << terminal.Screen();
    }
    EXPECT_EQ(ReadBytes(Geo()), original);
    EXPECT_EQ(Files(), untouched);
    EXPECT_FALSE(fs::exists(History())) << "a command run without the prompt is not kept";
}

} // namespace
