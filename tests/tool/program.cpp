#include "program.h"

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <iterator>

namespace vorel_test {

namespace fs = std::filesystem;

TempDir::TempDir() {
    std::string name = (fs::temp_directory_path() / "vorelpaint_test.XXXXXX").string();
    if (::mkdtemp(name.data()) == nullptr) std::abort();
    mPath = name;
}

TempDir::~TempDir() {
    std::error_code ignored;
    fs::remove_all(mPath, ignored);
}

std::string TempDir::write(const std::string& name, const std::string& bytes) const {
    std::ofstream(mPath / name, std::ios::binary) << bytes;
    return file(name);
}

std::vector<std::string> TempDir::list() const {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(mPath)) {
        names.push_back(entry.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    return names;
}

std::string readBytes(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

namespace {

void redirect(int descriptor, const std::string& path, int flags) {
    const int file = ::open(path.c_str(), flags, 0600);
    if (file < 0 || ::dup2(file, descriptor) < 0) ::_exit(127);
    ::close(file);
}

int runRedirected(const std::vector<std::string>& arguments, const std::string& in,
                  const std::string& out, const std::string& err) {
    std::vector<std::string> words{VORELPAINT_BINARY};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    for (std::string& word : words)
        argv.push_back(word.data());
    argv.push_back(nullptr);

    const pid_t child = ::fork();
    if (child == 0) {
        redirect(STDIN_FILENO, in, O_RDONLY);
        redirect(STDOUT_FILENO, out, O_WRONLY | O_CREAT);
        redirect(STDERR_FILENO, err, O_WRONLY | O_CREAT);
        ::execv(argv[0], argv.data());
        ::_exit(127);
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

}  // namespace

Outcome runVorelpaint(const std::vector<std::string>& arguments, const std::string& input) {
    const TempDir dir;
    const int exitCode =
        runRedirected(arguments, dir.write("in", input), dir.file("out"), dir.file("err"));
    return {exitCode, readBytes(dir.file("out")), readBytes(dir.file("err"))};
}

Outcome runVorelpaintInto(const std::string& outPath, const std::vector<std::string>& arguments) {
    const TempDir dir;
    const int exitCode = runRedirected(arguments, "/dev/null", outPath, dir.file("err"));
    return {exitCode, "", readBytes(dir.file("err"))};
}

}  // namespace vorel_test
