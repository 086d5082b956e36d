// Any line: refused, or rewritten so that every command is a builtin or a tool of the
// build, and every path word lies in the root.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include <string>
#include <vector>

#include "shell_line.h"

namespace {

const char kRoot[] = "/R";
const char kTools[] = "/T";
const char *const kBuiltins[] = {"echo", "printf", "true", "false", ":", "test", "[", "exit"};
const char *const kSeparators[] = {";", "&", "&&", "||", "|", "("};

[[noreturn]] void finding(const char *what, const std::string &line, const std::string &out) {
    fprintf(stderr, "%s\nline: %s\nout:  %s\n", what, line.c_str(), out.c_str());
    abort();
}

struct Token {
    std::string raw;   // as emitted
    std::string text;  // quotes removed
    bool quoted = false;
};

// The rewritten line: tokens are separated by single blanks; quoted parts use '...' with
// '\'' for a quote inside.
std::vector<Token> tokens(const std::string &out, const std::string &line) {
    std::vector<Token> all;
    Token t;
    for (size_t i = 0; i <= out.size(); i++) {
        if (i == out.size() || out[i] == ' ') {
            if (!t.raw.empty()) all.push_back(t);
            t = Token();
            continue;
        }
        if (out[i] == '\'') {
            size_t end = out.find('\'', i + 1);
            if (end == std::string::npos) finding("unterminated quote in output", line, out);
            t.raw += out.substr(i, end - i + 1);
            t.text += out.substr(i + 1, end - i - 1);
            t.quoted = true;
            i = end;
            continue;
        }
        if (out[i] == '\\') {
            if (i + 1 >= out.size() || out[i + 1] != '\'') finding("bare backslash", line, out);
            t.raw += "\\'";
            t.text += '\'';
            i++;
            continue;
        }
        if (strchr("$`*?[~\"", out[i]) != nullptr) finding("unquoted special", line, out);
        t.raw += out[i];
        t.text += out[i];
    }
    return all;
}

bool under_root_or_tools(const std::string &p) {
    return p.compare(0, 3, "/R/") == 0 || p == "/R" || p.compare(0, 3, "/T/") == 0;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string line(reinterpret_cast<const char *>(data), size);
    if (line.find('\0') != std::string::npos) return 0;  // a C string ends there
    ftxhost::ShellContext ctx;
    ctx.root = kRoot;
    ctx.toolDir = kTools;
    ctx.hasTool = [](const std::string &n) { return n == "toybox" || n == "rm" || n == "iwpriv"; };
    ctx.deviceHas = [](const std::string &p) { return p.size() % 2 == 0; };
    std::string out, why;
    if (ftxhost::shell_prepare(line, ctx, &out, &why) != 0) {
        if (why.empty()) finding("refused without a reason", line, out);
        return 0;
    }
    bool command = true;
    for (const Token &t : tokens(out, line)) {
        bool separator = false;
        for (const char *s : kSeparators)
            separator = separator || t.raw == s;
        if (separator) {
            command = true;
            continue;
        }
        if (t.raw == "/dev/null" && !command) continue;  // the host's, as an argument
        if (t.raw == ")") {
            command = false;
            continue;
        }
        size_t op = t.raw.find_first_not_of("0123456789");
        if (!t.quoted || t.raw[0] != '\'') {
            // A redirection: its target is a descriptor, /dev/null or a quoted root path.
            if (op == std::string::npos || (t.raw[op] != '<' && t.raw[op] != '>')) {
                finding("stray unquoted word", line, out);
            }
            size_t target = t.raw.find_first_not_of("<>&|", op);
            if (target == std::string::npos) finding("redirection without target", line, out);
            std::string rest = t.raw.substr(target);
            if (rest == "/dev/null" || rest == "-" ||
                rest.find_first_not_of("0123456789") == std::string::npos) {
                continue;
            }
            std::string path = t.text.substr(target);  // the operator part has no quotes
            if (rest[0] != '\'' || !under_root_or_tools(path)) {
                finding("redirection outside the root", line, out);
            }
            continue;
        }
        if (command) {
            bool builtin = false;
            for (const char *b : kBuiltins)
                builtin = builtin || t.text == b;
            if (!builtin && t.text.compare(0, 3, "/T/") != 0) finding("foreign command", line, out);
            if (!builtin && t.text.find('/', 3) != std::string::npos)
                finding("tool path", line, out);
            command = false;
        } else if (!t.text.empty() && t.text[0] == '/' && !under_root_or_tools(t.text)) {
            finding("path outside the root", line, out);
        }
    }
    return 0;
}
