// The auxiliary display's frame file.
#include "aux_fb.h"

#include <stdio.h>
#include <string.h>
#include <unistd.h>

#include <fstream>
#include <sstream>

namespace ftxhost {

namespace {

const char kMagic[] = "FTXFB1";
const size_t kHeaderMax = 64;

bool sane(int w, int h) {
    return w > 0 && h > 0 && w <= kAuxFbMaxSide && h <= kAuxFbMaxSide;
}

}  // namespace

AuxFrame aux_fb_plain(int width, int height, bool on, uint32_t colour) {
    AuxFrame f;
    f.width = width;
    f.height = height;
    f.on = on;
    f.pixels.assign(static_cast<size_t>(width) * static_cast<size_t>(height),
                    on ? colour & 0xFFFFFFu : 0u);
    return f;
}

std::string aux_fb_format(const AuxFrame &f) {
    char header[kHeaderMax];
    snprintf(header, sizeof(header), "%s %d %d %d\n", kMagic, f.width, f.height, f.on ? 1 : 0);
    std::string out(header);
    const size_t start = out.size();
    out.resize(start + f.pixels.size() * 4);
    for (size_t i = 0; i < f.pixels.size(); i++) {
        const uint32_t p = f.pixels[i];
        for (int b = 0; b < 4; b++)
            out[start + i * 4 + static_cast<size_t>(b)] = static_cast<char>((p >> (8 * b)) & 0xFF);
    }
    return out;
}

int aux_fb_parse(const std::string &bytes, AuxFrame *f) {
    if (f == nullptr) return -1;
    const size_t nl = bytes.find('\n');
    if (nl == std::string::npos || nl >= kHeaderMax) return -1;
    char header[kHeaderMax];
    memcpy(header, bytes.data(), nl);
    header[nl] = '\0';
    char magic[8];
    int w = 0, h = 0, on = 0, used = 0;
    if (sscanf(header, "%7s %d %d %d%n", magic, &w, &h, &on, &used) != 4 ||
        static_cast<size_t>(used) != nl || strcmp(magic, kMagic) != 0 || !sane(w, h) ||
        (on != 0 && on != 1))
        return -1;
    const size_t n = static_cast<size_t>(w) * static_cast<size_t>(h);
    if (bytes.size() - nl - 1 != n * 4) return -1;
    f->width = w;
    f->height = h;
    f->on = on == 1;
    f->pixels.resize(n);
    const unsigned char *p = reinterpret_cast<const unsigned char *>(bytes.data()) + nl + 1;
    for (size_t i = 0; i < n; i++, p += 4)
        f->pixels[i] =
            (p[0] | (p[1] << 8) | (p[2] << 16) | (static_cast<uint32_t>(p[3]) << 24)) & 0xFFFFFFu;
    return 0;
}

int aux_fb_write(const std::string &hostPath, const AuxFrame &f) {
    const std::string tmp = hostPath + ".tmp." + std::to_string(getpid());
    {
        std::ofstream out(tmp, std::ios::binary | std::ios::trunc);
        if (!out) return -1;
        const std::string bytes = aux_fb_format(f);
        out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        if (!out.flush()) {
            unlink(tmp.c_str());
            return -1;
        }
    }
    if (rename(tmp.c_str(), hostPath.c_str()) != 0) {
        unlink(tmp.c_str());
        return -1;
    }
    return 0;
}

int aux_fb_read(const std::string &hostPath, AuxFrame *f) {
    std::ifstream in(hostPath, std::ios::binary);
    if (!in) return -1;
    std::ostringstream s;
    s << in.rdbuf();
    return aux_fb_parse(s.str(), f);
}

}  // namespace ftxhost
