// mihost-exporter COMMAND [ARGUMENT...]: answers GET /metrics on the socket that systemd passes
// with what the command prints. libmicrohttpd speaks HTTP; see mihost-exporter(8).

#include "integrations/prometheus/exporter/Scrape.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <microhttpd.h>
#include <string_view>
#include <unistd.h>

namespace
{

// Shorter than the 10 seconds after which Prometheus gives up.
constexpr std::chrono::seconds timeLimit{9};
constexpr unsigned int connectionLimit = 16;
constexpr unsigned int idleSeconds = 30;
constexpr char openMetrics[] = "application/openmetrics-text; version=1.0.0; charset=utf-8";
constexpr char plain[] = "text/plain; charset=utf-8";

/** The one socket that systemd passes: sd_listen_fds(3). Negative for none. */
int passedSocket()
{
    constexpr int firstPassed = 3;
    char const* const process = std::getenv("LISTEN_PID");
    char const* const count = std::getenv("LISTEN_FDS");
    bool const isOurs = process && std::to_string(getpid()) == process;
    return isOurs && count && std::string_view(count) == "1" ? firstPassed : -1;
}

MHD_Result answer(MHD_Connection* connection, unsigned int status, std::string const& text,
                  char const* type)
{
    MHD_Response* const response = MHD_create_response_from_buffer(
        text.size(), const_cast<char*>(text.data()), MHD_RESPMEM_MUST_COPY);
    if (!response)
        return MHD_NO;
    MHD_add_response_header(response, MHD_HTTP_HEADER_CONTENT_TYPE, type);
    if (status == MHD_HTTP_METHOD_NOT_ALLOWED)
        MHD_add_response_header(response, MHD_HTTP_HEADER_ALLOW, "GET, HEAD");
    MHD_Result const result = MHD_queue_response(connection, status, response);
    MHD_destroy_response(response);
    return result;
}

/** One request at a time, so that many scrapers cost no more than one. */
MHD_Result handle(void* command, MHD_Connection* connection, char const* path, char const* method,
                  char const*, char const*, std::size_t* uploadSize, void** request)
{
    // The first call has the headers only; what a client uploads after them is skipped.
    static char seen;
    if (!*request) {
        *request = &seen;
        return MHD_YES;
    }
    if (*uploadSize != 0) {
        *uploadSize = 0;
        return MHD_YES;
    }
    std::string_view const wanted = method;
    if (wanted != MHD_HTTP_METHOD_GET && wanted != MHD_HTTP_METHOD_HEAD)
        return answer(connection, MHD_HTTP_METHOD_NOT_ALLOWED, "only GET and HEAD\n", plain);
    if (std::string_view(path) != "/metrics")
        return answer(connection, MHD_HTTP_NOT_FOUND, "only /metrics\n", plain);
    auto const text = scrape(*static_cast<std::vector<std::string>*>(command), timeLimit);
    if (!text)
        return answer(connection, MHD_HTTP_INTERNAL_SERVER_ERROR, "mihost printed no metrics\n",
                      plain);
    return answer(connection, MHD_HTTP_OK, *text, openMetrics);
}

} // namespace

int main(int argc, char* argv[])
{
    std::vector<std::string> command(argv + 1, argv + argc);
    if (command.empty()) {
        std::fputs("mihost-exporter COMMAND [ARGUMENT...]\n", stderr);
        return 2;
    }
    int const socket = passedSocket();
    if (socket < 0) {
        std::fputs("mihost-exporter: starting: no socket was passed (start it by "
                   "mihost-exporter.socket)\n",
                   stderr);
        return 2;
    }
    // Its commands must not inherit the socket.
    fcntl(socket, F_SETFD, FD_CLOEXEC);
    for (char const* name : {"LISTEN_PID", "LISTEN_FDS", "LISTEN_FDNAMES"})
        unsetenv(name);
    // Blocked before the server's thread starts, so that only this one gets them.
    sigset_t endings;
    sigemptyset(&endings);
    sigaddset(&endings, SIGINT);
    sigaddset(&endings, SIGTERM);
    sigprocmask(SIG_BLOCK, &endings, nullptr);

    MHD_Daemon* const server = MHD_start_daemon(
        MHD_USE_AUTO | MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_ERROR_LOG, 0, nullptr, nullptr,
        handle, &command, MHD_OPTION_LISTEN_SOCKET, socket, MHD_OPTION_CONNECTION_LIMIT,
        connectionLimit, MHD_OPTION_CONNECTION_TIMEOUT, idleSeconds, MHD_OPTION_END);
    if (!server) {
        std::fputs("mihost-exporter: starting: the server cannot use the socket\n", stderr);
        return 1;
    }
    int signal = 0;
    sigwait(&endings, &signal);
    MHD_stop_daemon(server);
    return 0;
}
