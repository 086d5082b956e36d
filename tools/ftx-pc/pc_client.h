// Client side of the PC command channel: one TCP connection, one command line at a time,
// each answered "<result> <n>\n" + n bytes + "\n".
#pragma once

#include <string>

namespace ftxpc {

class PcClient {
  public:
    PcClient() = default;
    ~PcClient();
    PcClient(const PcClient &) = delete;
    PcClient &operator=(const PcClient &) = delete;

    // Connects to host:port; 0 or -1.
    int connect_to(const char *host, int port, int timeout_ms = 5000);
    void close_connection();
    bool connected() const { return fd_ >= 0; }
    // Sends raw bytes as they are (no line end added); 0 or -1.
    int send_raw(const std::string &bytes);
    // Tells the handset no more commands come; answers can still be read. 0 or -1.
    int finish_sending();
    // Reads one answer; returns its result (0, 2, 3) and fills reply, or -1 when the
    // connection broke or the answer was malformed.
    int read_answer(std::string *reply, int timeout_ms = 30000);
    // Sends line plus LF and reads its answer.
    int command(const std::string &line, std::string *reply, int timeout_ms = 30000);

  private:
    bool fill(int timeout_ms);
    int fd_ = -1;
    std::string in_;
};

}  // namespace ftxpc
