// The desktop window opening: a person starts pyralis-bureau and sees the job. Measured as a program
// just started that loads the module, builds the window, draws the demo GéoBase in it and writes the
// picture (--capture, without a display); the target is under a second.
#include <benchmark/benchmark.h>
#include <filesystem>
#include <spawn.h>
#include <string>
#include <sys/wait.h>

extern char** environ;

namespace pyr::bench {

namespace {

void BM_WindowOpensOnTheDemoJob(benchmark::State& state) {
    const std::filesystem::path folder = std::filesystem::temp_directory_path() / "pyr_bench_bureau";
    std::filesystem::create_directories(folder);
    const std::string geo = (folder / "chantier-demo.geo").string();
    std::filesystem::copy_file(PYR_DATA_DIR "/chantier-demo.geo", geo,
                               std::filesystem::copy_options::overwrite_existing);
    const std::string program = PYR_PROGRAM_DIR "/pyralis-bureau";
    const std::string params = (folder / "Pyralis.ini").string();
    const std::string picture = (folder / "fenetre.png").string();
    for (auto _ : state) {
        char* argv[] = {const_cast<char*>(program.c_str()), const_cast<char*>("--params"),
                        const_cast<char*>(params.c_str()),  const_cast<char*>("--geobase"),
                        const_cast<char*>(geo.c_str()),     const_cast<char*>("--capture"),
                        const_cast<char*>(picture.c_str()), nullptr};
        pid_t child = 0;
        int status = 0;
        if (posix_spawn(&child, program.c_str(), nullptr, nullptr, argv, environ) != 0 ||
            waitpid(child, &status, 0) != child || !WIFEXITED(status) || WEXITSTATUS(status) != 0)
            state.SkipWithError("pyralis-bureau n'a pas dessiné sa fenêtre");
    }
    std::filesystem::remove_all(folder);
}
BENCHMARK(BM_WindowOpensOnTheDemoJob)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(5);

} // namespace

} // namespace pyr::bench
