// A private device root for one test: made under /tmp, FTX_ROOT points at it while the
// object lives, and the platform forgets what it cached about the previous root.
#pragma once

#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "ftx_host.h"

class TempRoot {
  public:
    TempRoot() {
        char tmpl[] = "/tmp/ftx-test-XXXXXX";
        path_ = mkdtemp(tmpl);
        setenv("FTX_ROOT", path_.c_str(), 1);
        ftx_host_reset();
    }
    ~TempRoot() {
        ftx_host_reset();
        std::error_code ec;
        std::filesystem::remove_all(path_, ec);
    }
    const std::string &path() const { return path_; }
    std::string host(const std::string &devicePath) const { return path_ + devicePath; }

    // Writes a file at a device path, making its folders.
    void write(const std::string &devicePath, const std::string &content) const {
        std::filesystem::path p(host(devicePath));
        std::filesystem::create_directories(p.parent_path());
        std::ofstream(p, std::ios::binary) << content;
    }
    std::string read(const std::string &devicePath) const {
        std::ifstream in(host(devicePath), std::ios::binary);
        return std::string((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    }
    bool exists(const std::string &devicePath) const {
        return std::filesystem::exists(host(devicePath));
    }

  private:
    std::string path_;
};
