#include "fieldbook/Preformat.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookTexts.h"
#include "ui/FrontEnd.h"

#include <cerrno>
#include <spawn.h>
#include <sys/wait.h>
#include <thread>
#include <vector>

extern char** environ;

namespace pyr {

namespace {

constexpr std::chrono::milliseconds kPollInterval{5};

// Whether the process ended within the time given.
bool WaitFor(pid_t pid, std::chrono::milliseconds wait) {
    const auto deadline = std::chrono::steady_clock::now() + wait;
    while (true) {
        int status = 0;
        const pid_t ended = waitpid(pid, &status, WNOHANG);
        if (ended == pid || (ended < 0 && errno != EINTR)) return true;
        if (std::chrono::steady_clock::now() >= deadline) return false;
        std::this_thread::sleep_for(kPollInterval);
    }
}

} // namespace

PreformatOutcome Preformat(const std::string& carnet, const std::string& program, ui::FrontEnd& parent,
                           std::chrono::milliseconds wait) {
    if (program.empty()) return {carnet, false};
    if (!FileExists(program)) {
        parent.MessageBox(Sprintf(fb::kMsgPreformatMissing, program.c_str()), ui::kCaption, ui::kIconWarning);
        return {carnet, false};
    }
    std::string programArg = program;
    std::string carnetArg = carnet;
    std::vector<char*> argv{programArg.data(), carnetArg.data(), nullptr};
    pid_t pid = 0;
    if (posix_spawn(&pid, program.c_str(), nullptr, nullptr, argv.data(), environ) != 0) {
        parent.MessageBox(Sprintf(fb::kMsgPreformatFailed, program.c_str()), ui::kCaption, ui::kIconWarning);
        return {carnet, false};
    }
    // A program that outlives the wait is reaped when it ends, so that it leaves no zombie behind.
    if (!WaitFor(pid, wait)) std::thread([pid] { waitpid(pid, nullptr, 0); }).detach();
    const std::string temporary = BesideCarnet(carnet, "tmp");
    return {temporary, temporary != carnet};
}

} // namespace pyr
