// The sibling is terminal_win.cpp.

#include "tools/zbtool/terminal.h"

#include <array>
#include <csignal>
#include <cstdio>
#include <iostream>
#include <termios.h>
#include <unistd.h>

namespace zbtool {
namespace {

constexpr std::array ENDING_SIGNALS{SIGINT, SIGQUIT, SIGTERM, SIGHUP};

termios shownInput;

void show() { ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &shownInput); }

/// The signal then does what it does by default.
void showAndEnd(int signal) {
    show();
    ::raise(signal);
}

/// For as long as it lives the terminal does not show what is typed. A signal that ends the program ends that, too.
class HiddenInput {
public:
    HiddenInput() {
        ::tcgetattr(STDIN_FILENO, &shownInput);
        for (std::size_t i = 0; i < ENDING_SIGNALS.size(); ++i) watch(ENDING_SIGNALS[i], former_[i]);
        termios hidden = shownInput;
        hidden.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &hidden);
    }
    ~HiddenInput() {
        show();
        for (std::size_t i = 0; i < ENDING_SIGNALS.size(); ++i) ::sigaction(ENDING_SIGNALS[i], &former_[i], nullptr);
    }
    HiddenInput(HiddenInput const&) = delete;
    HiddenInput& operator=(HiddenInput const&) = delete;

private:
    static void watch(int signal, struct sigaction& former) {
        struct sigaction action {};
        action.sa_handler = showAndEnd;
        action.sa_flags = static_cast<int>(SA_RESETHAND);
        ::sigaction(signal, nullptr, &former);
        if (former.sa_handler != SIG_IGN) ::sigaction(signal, &action, nullptr);
    }

    std::array<struct sigaction, ENDING_SIGNALS.size()> former_{};
};

} // namespace

bool inputIsTerminal() { return ::isatty(STDIN_FILENO) != 0; }
bool outputIsTerminal() { return ::isatty(STDOUT_FILENO) != 0; }
bool errorsAreTerminal() { return ::isatty(STDERR_FILENO) != 0; }

bool readHidden(char const* prompt, std::string& line) {
    std::fputs(prompt, stderr);
    bool const good = [&] {
        HiddenInput const hidden;
        return static_cast<bool>(std::getline(std::cin, line));
    }();
    std::fputc('\n', stderr);
    return good;
}

void useBinaryStreams() {}

} // namespace zbtool
