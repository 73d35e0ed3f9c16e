#include "tests/cli/programRunner.h"

#include "cli/greyOfPhoto.h"
#include "host/pfm.h"
#include "host/photoWriter.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <stdexcept>
#include <thread>

namespace TestSupport
{
namespace
{

using clock = std::chrono::steady_clock;

[[noreturn]] void becomeProgram(const std::filesystem::path &folder, const std::vector<std::string> &arguments,
                                const runRules &rules)
{
    if (rules.largestFile)
    {
        const rlimit limit{*rules.largestFile, *rules.largestFile};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    for (const int number : {SIGINT, SIGTERM, SIGHUP})
        signal(number, SIG_DFL);
    std::vector<char *> words{const_cast<char *>(STILLMARK_BINARY)};
    for (const std::string &argument : arguments)
        words.push_back(const_cast<char *>(argument.c_str()));
    words.push_back(nullptr);
    if (chdir(folder.c_str()) == 0)
        execv(STILLMARK_BINARY, words.data());
    _exit(127);
}

struct outputPipe
{
    int ends[2];
    outputPipe()
    {
        if (pipe2(ends, O_CLOEXEC) != 0)
            throw std::runtime_error("no pipe");
    }
};

/// Reads both ends until the program closes them; sends the signals on the way.
void watch(programRun &run, pid_t child, const std::array<int, 2> &ends, const runRules &rules)
{
    const auto began = clock::now();
    auto signalTime = began + rules.signalAfter.value_or(std::chrono::hours(1));
    auto counted = began;
    std::size_t sent = 0;
    const std::array<std::string *, 2> texts = {&run.out, &run.err};
    std::array<pollfd, 2> polled = {pollfd{ends[0], POLLIN, 0}, pollfd{ends[1], POLLIN, 0}};
    while (polled[0].fd >= 0 || polled[1].fd >= 0)
    {
        poll(polled.data(), polled.size(), 5);
        for (std::size_t i = 0; i < 2; ++i)
        {
            std::array<char, 4096> bytes{};
            if (polled[i].fd < 0 || polled[i].revents == 0)
                continue;
            const ssize_t count = read(polled[i].fd, bytes.data(), bytes.size());
            if (count <= 0)
                polled[i].fd = -1;
            else
                texts[i]->append(bytes.data(), static_cast<std::size_t>(count));
        }
        const auto now = clock::now();
        if (sent < rules.signals.size() && now >= signalTime)
        {
            if (sent == 0)
                counted = now;
            kill(child, rules.signals[sent++]);
            signalTime = now + std::chrono::milliseconds(20);
        }
        if (now - began > std::chrono::minutes(1))
            kill(child, SIGKILL);
    }
    run.seconds = std::chrono::duration<double>(clock::now() - counted).count();
}

} // namespace

programRun runProgram(const std::filesystem::path &folder, const std::vector<std::string> &arguments,
                      const runRules &rules)
{
    // One folder for tables and preferences of all tests, away from the user's.
    static const temporaryFolder own;
    setenv("XDG_CACHE_HOME", own.path().c_str(), 1);
    setenv("XDG_CONFIG_HOME", own.path().c_str(), 1);

    const outputPipe out, err;
    const pid_t child = fork();
    if (child == 0)
    {
        dup2(out.ends[1], STDOUT_FILENO);
        dup2(err.ends[1], STDERR_FILENO);
        becomeProgram(folder, arguments, rules);
    }
    close(out.ends[1]);
    close(err.ends[1]);
    programRun run;
    watch(run, child, {out.ends[0], err.ends[0]}, rules);
    close(out.ends[0]);
    close(err.ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    run.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return run;
}

void writeGrey(const std::string &path, const CorvaneDeblur::floatArray &grey)
{
    Stillmark::floatRaster raster{grey.cols, grey.rows, 1, {}};
    for (int y = 0; y < grey.rows; ++y)
        raster.samples.insert(raster.samples.end(), grey.row(y), grey.row(y) + grey.cols);
    if (path.ends_with(".pfm"))
        return writePfm(path, raster);

    const std::string exact = path + ".pfm";
    writePfm(exact, raster);
    Stillmark::photoWriter writer(Stillmark::photo::open(exact), path);
    writer.write({0, 0, grey.cols, grey.rows}, raster.samples.data(),
                 sizeof(float) * static_cast<std::size_t>(grey.cols));
    writer.commit();
    std::filesystem::remove(exact);
}

CorvaneDeblur::floatArray readGrey(const std::string &path)
{
    Stillmark::greyOfPhoto source(Stillmark::photo::open(path));
    const auto grey = CorvaneDeblur::floatArray::allocate(source.rows(), source.cols());
    source.readGrey({0, 0, source.cols(), source.rows()}, grey);
    return grey;
}

} // namespace TestSupport
