// log_fork_child: logs a line, forks a copy that ends normally, waits for it and ends normally itself.

#include <zor_basis/log.h>

#include <sys/wait.h>
#include <unistd.h>

int main() {
    ZOR_Basis::Log log("child");
    log.out("line 1");
    pid_t const copy = fork();
    if (copy == 0) return 0;
    int status = 0;
    return waitpid(copy, &status, 0) == copy ? status : 1;
}
