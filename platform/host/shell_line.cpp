// Device shell lines for the host shell. The handset's shell finds its tools in
// /system/bin; on the host those tools are programs of the build (an allow-list by name:
// whatever the build put in its handset tool folder), so a file that a PC client wrote into
// the device root can never run, whatever the line names.
#include "shell_line.h"

#include <ctype.h>
#include <string.h>

#include <vector>

namespace ftxhost {
namespace {

// Builtins of the shell that neither run files nor change how later words are looked up.
const char *const kBuiltins[] = {"echo", "printf", "true", "false", ":", "test", "[", "exit"};

// Where the handset keeps the tools that a line may name by path.
const char *const kToolFolders[] = {"/system/bin", "/system/xbin", "/vendor/bin",
                                    "/system/vendor/bin"};

// Longest first, so "&&" is not read as two "&".
const char *const kOperators[] = {"&&", "||", ";;", ">>", ">&", "<&", "<>", ">|", "<<",
                                  ";",  "&",  "|",  "(",  ")",  "<",  ">",  "\n"};

bool is_blank(char c) {
    return c == ' ' || c == '\t';
}

bool is_operator_char(char c) {
    return c != '\0' && strchr(";&|()<>\n", c) != nullptr;
}

bool is_redirection(const std::string &op) {
    return op[0] == '<' || op[0] == '>';
}

bool all_digits(const std::string &s) {
    return !s.empty() && s.find_first_not_of("0123456789") == std::string::npos;
}

bool valid_tool_name(const std::string &name) {
    if (name.empty() || name == "." || name == "..") return false;
    return name.find_first_not_of(
               "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
               "0123456789._+-") == std::string::npos;
}

// "NAME=..." with a shell variable name before the '='.
bool is_assignment(const std::string &word) {
    size_t eq = word.find('=');
    if (eq == 0 || eq == std::string::npos) return false;
    if (isdigit(static_cast<unsigned char>(word[0]))) return false;
    for (size_t i = 0; i < eq; i++) {
        unsigned char c = static_cast<unsigned char>(word[i]);
        if (!isalnum(c) && c != '_') return false;
    }
    return true;
}

std::string quote(const std::string &s) {
    std::string out = "'";
    for (char c : s) {
        if (c == '\'') {
            out += "'\\''";
        } else {
            out += c;
        }
    }
    return out + "'";
}

class LinePreparer {
  public:
    LinePreparer(const std::string &line, const ShellContext &ctx) : s_(line), ctx_(ctx) {}

    int run(std::string *out, std::string *why) {
        bool ok = prepare();
        if (ok) {
            *out = out_;
        } else {
            *why = why_;
        }
        return ok ? 0 : -1;
    }

  private:
    struct Word {
        std::string text;
        bool quoted = false;
        bool pattern = false;
    };

    bool fail(const std::string &why) {
        why_ = why;
        return false;
    }

    void emit(const std::string &token, bool glued = false) {
        if (!out_.empty() && !glued) out_ += ' ';
        out_ += token;
    }

    std::string read_operator() {
        for (const char *op : kOperators) {
            size_t len = strlen(op);
            if (s_.compare(i_, len, op) == 0) {
                i_ += len;
                return op;
            }
        }
        return std::string(1, s_[i_++]);  // not reached: the caller saw an operator char
    }

    bool read_double_quoted(Word *w) {
        w->quoted = true;
        for (i_++; i_ < s_.size(); i_++) {
            char c = s_[i_];
            if (c == '"') {
                i_++;
                return true;
            }
            if (c == '$' || c == '`') return fail("expansions are not run on the host");
            if (c == '\\' && i_ + 1 < s_.size() && strchr("$`\"\\\n", s_[i_ + 1]) != nullptr) {
                if (s_[++i_] != '\n') w->text += s_[i_];
                continue;
            }
            w->text += c;
        }
        return fail("unterminated quote");
    }

    bool read_word(Word *w) {
        while (i_ < s_.size() && !is_blank(s_[i_]) && !is_operator_char(s_[i_])) {
            char c = s_[i_];
            if (c == '\'') {
                size_t end = s_.find('\'', i_ + 1);
                if (end == std::string::npos) return fail("unterminated quote");
                w->text.append(s_, i_ + 1, end - i_ - 1);
                w->quoted = true;
                i_ = end + 1;
            } else if (c == '"') {
                if (!read_double_quoted(w)) return false;
            } else if (c == '\\') {
                if (i_ + 1 >= s_.size()) return fail("a line may not end in a backslash");
                w->quoted = true;
                if (s_[i_ + 1] != '\n') w->text += s_[i_ + 1];
                i_ += 2;
            } else if (c == '$' || c == '`') {
                return fail("expansions are not run on the host");
            } else {
                if (c == '*' || c == '?' || c == '[') w->pattern = true;
                w->text += c;
                i_++;
            }
        }
        return true;
    }

    std::string host_path(const std::string &devicePath) const {
        return ctx_.root + normalise_device_path(devicePath);
    }

    bool command_word(const Word &w) {
        const std::string &t = w.text;
        if (t.empty()) return fail("empty command name");
        if (is_assignment(t)) return fail("variable assignments are not run on the host");
        if (t.find('/') != std::string::npos) {
            if (t[0] != '/') return fail(t + ": a command path must be absolute");
            std::string device = normalise_device_path(t);
            size_t slash = device.rfind('/');
            std::string folder = device.substr(0, slash), name = device.substr(slash + 1);
            bool known = false;
            for (const char *f : kToolFolders)
                known = known || folder == f;
            if (!known) return fail(t + ": not a folder of the handset's tools");
            if (!ctx_.deviceHas(device)) return fail(t + ": not found");
            if (!valid_tool_name(name) || !ctx_.hasTool(name)) {
                return fail(t + ": no such tool in this build");
            }
            emit(quote(ctx_.toolDir + "/" + name));
            return true;
        }
        for (const char *b : kBuiltins) {
            if (t == b) {
                emit(quote(t));
                return true;
            }
        }
        if (!valid_tool_name(t) || !ctx_.hasTool(t)) return fail(t + ": not a handset tool");
        emit(quote(ctx_.toolDir + "/" + t));
        return true;
    }

    void argument_word(const Word &w) {
        const std::string &t = w.text;
        if (t == "/dev/null") {
            emit(t);
        } else if (!t.empty() && t[0] == '/') {
            emit(quote(host_path(t)));
        } else {
            // "key=/path" (module and tool options) names a device path too.
            size_t eq = t.find("=/");
            if (eq != std::string::npos && t.find('/') == eq + 1) {
                emit(quote(t.substr(0, eq + 1) + host_path(t.substr(eq + 1))));
            } else {
                emit(quote(t));
            }
        }
    }

    bool redirection_target(const std::string &op, const Word &w) {
        const std::string &t = w.text;
        if (op == ">&" || op == "<&") {
            if (w.quoted || (!all_digits(t) && t != "-")) {
                return fail("\"" + op + "\" takes a descriptor number");
            }
            emit(t, true);
            return true;
        }
        if (t.empty()) return fail("empty redirection target");
        emit(t == "/dev/null" ? t : quote(host_path(t)), true);
        return true;
    }

    bool prepare() {
        bool commandPosition = true;
        std::string redirection;  // an operator still waiting for its target
        while (true) {
            while (i_ < s_.size() && is_blank(s_[i_]))
                i_++;
            if (i_ >= s_.size() || s_[i_] == '#') break;  // end, or a comment
            if (is_operator_char(s_[i_])) {
                if (!redirection.empty()) return fail("a redirection lacks its target");
                std::string op = read_operator();
                if (op == "<<") return fail("here-documents are not supported");
                if (op == ";;") return fail("\";;\" outside a case");
                if (is_redirection(op)) {
                    emit(op);
                    redirection = op;
                    continue;
                }
                emit(op == "\n" ? ";" : op);
                commandPosition = op != ")";
                continue;
            }
            Word w;
            if (!read_word(&w)) return false;
            if (!w.quoted && all_digits(w.text) && i_ < s_.size() &&
                (s_[i_] == '<' || s_[i_] == '>') && redirection.empty()) {
                std::string op = read_operator();  // "2>" and the like: a descriptor number
                if (op == "<<") return fail("here-documents are not supported");
                emit(w.text + op);
                redirection = op;
                continue;
            }
            if (w.pattern) return fail(w.text + ": patterns are not expanded on the host");
            if (!redirection.empty()) {
                if (!redirection_target(redirection, w)) return false;
                redirection.clear();
            } else if (commandPosition) {
                if (!command_word(w)) return false;
                commandPosition = false;
            } else {
                argument_word(w);
            }
        }
        if (!redirection.empty()) return fail("a redirection lacks its target");
        return true;
    }

    const std::string &s_;
    const ShellContext &ctx_;
    size_t i_ = 0;
    std::string out_;
    std::string why_;
};

}  // namespace

std::string normalise_device_path(const std::string &path) {
    std::vector<std::string> parts;
    size_t i = 0;
    while (i < path.size()) {
        size_t end = path.find('/', i);
        if (end == std::string::npos) end = path.size();
        std::string part = path.substr(i, end - i);
        i = end + 1;
        if (part.empty() || part == ".") continue;
        if (part == "..") {
            if (!parts.empty()) parts.pop_back();
            continue;
        }
        parts.push_back(part);
    }
    std::string out;
    for (const std::string &p : parts)
        out += "/" + p;
    if (out.empty()) return "/";
    if (path.back() == '/') out += "/";
    return out;
}

int shell_prepare(const std::string &line, const ShellContext &ctx, std::string *out,
                  std::string *why) {
    return LinePreparer(line, ctx).run(out, why);
}

}  // namespace ftxhost
