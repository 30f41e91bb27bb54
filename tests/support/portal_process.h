#pragma once

#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdint>
#include <fstream>
#include <optional>
#include <stdexcept>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "tests/support/temp_folder.h"

namespace zebtell::testing {

// A program that runs beside the test and is killed with it. What it writes goes to a file.
class Process {
  public:
    Process(const std::vector<std::string>& command, const std::string& output) {
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(
            &actions, STDOUT_FILENO, output.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
        posix_spawn_file_actions_adddup2(&actions, STDOUT_FILENO, STDERR_FILENO);
        std::vector<char*> arguments;
        for (const std::string& word : command)
            arguments.push_back(const_cast<char*>(word.c_str()));
        arguments.push_back(nullptr);
        const int error =
            posix_spawn(&id_, arguments[0], &actions, nullptr, arguments.data(), environ);
        posix_spawn_file_actions_destroy(&actions);
        if (error != 0) throw std::runtime_error("cannot run " + command.front());
    }
    ~Process() {
        if (id_ <= 0) return;
        ::kill(id_, SIGKILL);
        Wait();
    }
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;

    pid_t id() const { return id_; }
    // Its exit status; -1 when a signal ended it.
    int Wait() {
        int status = 0;
        ::waitpid(std::exchange(id_, 0), &status, 0);
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }

  private:
    pid_t id_ = 0;
};

// `zebtell serve` with the demo company, as an operator starts it, on a free port.
class PortalProcess {
  public:
    explicit PortalProcess(const std::string& program) {
        const std::string output = folder_.path() / "output";
        if (Process({program, "demo", "--folder", folder_.path()}, output).Wait() != 0)
            throw std::runtime_error("no demo company: " + folder_.Read("output"));
        process_.emplace(
            std::vector<std::string>{program, "serve", "--folder", folder_.path(), "--port", "0"},
            output);
        for (int tries = 0; tries < 200 && port_ == 0; ++tries) {
            std::this_thread::sleep_for(std::chrono::milliseconds(50));
            const std::string said = folder_.Read("output");
            const std::size_t mark = said.find("127.0.0.1:");
            if (mark != said.npos && said.find('/', mark) != said.npos)
                port_ = static_cast<std::uint16_t>(std::stoi(said.substr(mark + 10)));
        }
        if (port_ == 0) throw std::runtime_error("does not serve: " + folder_.Read("output"));
    }

    std::uint16_t port() const { return port_; }
    // Memory that it really uses.
    std::size_t ResidentBytes() const {
        std::ifstream status("/proc/" + std::to_string(process_->id()) + "/status");
        for (std::string word; status >> word;) {
            std::size_t kib = 0;
            if (word == "VmRSS:" && status >> kib) return kib * 1024;
        }
        throw std::runtime_error("no VmRSS");
    }

  private:
    TempFolder folder_;
    std::optional<Process> process_;
    std::uint16_t port_ = 0;
};

}  // namespace zebtell::testing
