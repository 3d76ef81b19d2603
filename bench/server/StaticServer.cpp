// The least that an HTTP server can do with the same library: every POST gets the same reply.
// Arguments: the size of the reply in bytes. Prints its port; ends with its standard input.

#include <microhttpd.h>

#include <cstdio>
#include <cstdlib>
#include <string>

namespace {

std::string reply;

MHD_Result answer(void*, MHD_Connection* connection, const char*, const char*, const char*,
                  const char*, std::size_t* size, void** context) {
  static int started = 0;
  if (*context == nullptr) {
    *context = &started;
    return MHD_YES;
  }
  if (*size > 0) {
    *size = 0;
    return MHD_YES;
  }
  MHD_Response* const response =
      MHD_create_response_from_buffer(reply.size(), reply.data(), MHD_RESPMEM_PERSISTENT);
  MHD_add_response_header(response, "Content-Type", "application/xml; charset=\"utf-8\"");
  MHD_add_response_header(response, "CIMOperation", "MethodResponse");
  const MHD_Result result = MHD_queue_response(connection, MHD_HTTP_OK, response);
  MHD_destroy_response(response);
  return result;
}

}  // namespace

int main(int argc, char** argv) {
  reply.assign(argc > 1 ? std::strtoul(argv[1], nullptr, 10) : 600, 'x');
  MHD_Daemon* const daemon =
      MHD_start_daemon(MHD_USE_EPOLL_INTERNAL_THREAD, 0, nullptr, nullptr, answer, nullptr,
                       MHD_OPTION_THREAD_POOL_SIZE, 2U, MHD_OPTION_END);
  if (daemon == nullptr) return 1;
  std::printf("%u\n", MHD_get_daemon_info(daemon, MHD_DAEMON_INFO_BIND_PORT)->port);
  std::fflush(stdout);
  while (std::getchar() != EOF) {
  }
  MHD_stop_daemon(daemon);
  return 0;
}
