#include <atomic>
#include <chrono>

#include <gtest/gtest.h>

#include "tp_os.h"

extern "C" const TP_I18N_DOMAIN language_domains[];

namespace {

const TP_I18N_TEXT kEn[] = {{"softkeybar_back", "Back"}, {nullptr, nullptr}};
const TP_I18N_TEXT kZh[] = {{"softkeybar_back", "\xb7\xb5\xbb\xd8"}, {nullptr, nullptr}};

}  // namespace

// This test program plays the application that exports the built-in texts.
extern "C" const TP_I18N_DOMAIN language_domains[] = {{"en", kEn}, {"zh", kZh}, {nullptr, nullptr}};

namespace {

TEST(TpOs, SemaphoresWaitPostAndTimeOut) {
    tp_os_thread_init(0, nullptr);
    int id = tp_os_sema_named("test.ready", 0);
    ASSERT_GT(id, 0);
    EXPECT_EQ(id, tp_os_sema_named("test.ready", 5));
    EXPECT_EQ(-1, tp_os_sema_get(id, 20));

    static std::atomic<int> ran{0};
    struct Arg {
        int id;
    } arg{id};
    tp_os_thread_t t = tp_os_thread_create(
        "poster", 0, 128 * 1024,
        [](void *p) -> void * {
            ran = 1;
            tp_os_sema_put(static_cast<Arg *>(p)->id);
            return nullptr;
        },
        &arg);
    ASSERT_NE(0u, t);
    EXPECT_EQ(0, tp_os_sema_get(id, TP_OS_WAIT_FOREVER));
    EXPECT_EQ(1, ran.load());
    EXPECT_EQ(-1, tp_os_sema_get(TP_OS_SEMA_MAX, 0));
    EXPECT_EQ(-1, tp_os_sema_put(-1));
}

TEST(TpOs, BoundedCopyAlwaysTerminates) {
    char buf[4];
    EXPECT_EQ(3u, tp_os_strlcpy(buf, "abcdef", sizeof(buf)));
    EXPECT_STREQ("abc", buf);
    EXPECT_EQ(0u, tp_os_strlcpy(buf, nullptr, sizeof(buf)));
    EXPECT_STREQ("", buf);
}

TEST(TpI18n, DomainsByNameAndLocale) {
    EXPECT_STREQ("Back", tp_i18n_get_text("en", "softkeybar_back"));
    EXPECT_STREQ("\xb7\xb5\xbb\xd8", tp_i18n_get_text("zh", "softkeybar_back"));
    EXPECT_STREQ("softkeybar_ok", tp_i18n_get_text("en", "softkeybar_ok"));
    EXPECT_STREQ("softkeybar_back", tp_i18n_get_text("fr", "softkeybar_back"));
    EXPECT_STREQ("Back", tp_i18n_get_text(nullptr, "softkeybar_back"));
}

}  // namespace
