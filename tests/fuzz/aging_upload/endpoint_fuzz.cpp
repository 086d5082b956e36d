// Any text as the configured endpoint of the aging upload: an accepted one makes exactly
// "http://<host>:<port>/aging/record" with a host of host-name or bracketed address
// characters and a port in 1..65535; a refused one leaves an empty URL; a short output
// buffer is never overrun (the first input byte chooses its size).
#include <stddef.h>
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <string>

#include "AgingTest/mmi_aging_upload.h"

namespace {

[[noreturn]] void finding(const char *what, const std::string &endpoint, const char *url) {
    fprintf(stderr, "%s\nendpoint: %s\nurl:      %s\n", what, endpoint.c_str(), url);
    abort();
}

bool host_text(const std::string &h) {
    if (h.empty()) return false;
    if (h.front() == '[') {
        if (h.size() < 3 || h.back() != ']') return false;
        return strspn(h.c_str() + 1, "0123456789abcdefABCDEF:.") == h.size() - 2;
    }
    return strspn(h.c_str(), "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789-.") ==
           h.size();
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int *, char ***) {
    static char root[] = "/tmp/ftx-fuzz-aging-XXXXXX";
    if (getenv("FTX_ROOT") == nullptr && mkdtemp(root) != nullptr) setenv("FTX_ROOT", root, 1);
    setenv("FTX_LOG_LEVEL", "F", 1);  // the refusals are not written out
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size == 0) return 0;
    const size_t small = data[0] % MMI_AGING_URL_SIZE;
    const std::string endpoint(reinterpret_cast<const char *>(data + 1), size - 1);
    const std::string text = endpoint.substr(0, endpoint.find('\0'));

    char url[MMI_AGING_URL_SIZE];
    const int rc = mmi_aging_upload_url(endpoint.c_str(), url, sizeof(url));
    if (rc != 0) {
        if (url[0] != '\0') finding("refused with a URL", text, url);
    } else {
        const std::string u(url);
        const std::string head = "http://", tail = "/aging/record";
        if (text.size() > MMI_AGING_ENDPOINT_MAX) finding("too long accepted", text, url);
        if (u.compare(0, head.size(), head) != 0 || u.size() < head.size() + tail.size() ||
            u.compare(u.size() - tail.size(), tail.size(), tail) != 0)
            finding("not the record URL", text, url);
        const std::string hostPort = u.substr(head.size(), u.size() - head.size() - tail.size());
        const size_t colon = hostPort.rfind(':');
        if (colon == std::string::npos) finding("no port", text, url);
        if (!host_text(hostPort.substr(0, colon))) finding("bad host", text, url);
        const std::string port = hostPort.substr(colon + 1);
        if (port.empty() || port.size() > 5 || port[0] == '0' ||
            strspn(port.c_str(), "0123456789") != port.size() || atol(port.c_str()) > 65535)
            finding("bad port", text, url);
        if (text.compare(0, colon, hostPort, 0, colon) != 0) finding("host changed", text, url);
    }

    // The same into a buffer of the chosen size, in a block of its own for ASan.
    char *out = static_cast<char *>(malloc(small == 0 ? 1 : small));
    const int rcSmall = mmi_aging_upload_url(endpoint.c_str(), out, small);
    if (small > 0) {
        if (rcSmall == 0 && (rc != 0 || strcmp(out, url) != 0))
            finding("short buffer answered differently", text, out);
        if (rcSmall != 0 && out[0] != '\0') finding("short buffer left text", text, out);
    }
    free(out);
    return 0;
}
