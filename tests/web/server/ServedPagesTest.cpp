#include "web/server/ServedPages.h"

#include <gtest/gtest.h>

namespace {

PageFrame Put(const std::string& path, const std::string& body) {
  return {.Order = PageOrder::Put, .Path = path, .Body = body};
}

TEST(PagesInMemory, AppearTogetherWhenTheyAreShown) {
  ServedPages pages;
  EXPECT_TRUE(pages.Take(Put("/", "a")));
  EXPECT_TRUE(pages.Take(Put("/b", "bc")));
  EXPECT_EQ(pages.Find("/"), nullptr);
  EXPECT_TRUE(pages.Take({}));
  ASSERT_NE(pages.Find("/"), nullptr);
  EXPECT_EQ(pages.Find("/b")->Body, "bc");
  EXPECT_EQ(pages.Count(), 2U);
  EXPECT_EQ(pages.Bytes(), 3U);
}

TEST(PagesInMemory, StayForThoseWhoStillReadThem) {
  ServedPages pages;
  pages.Take(Put("/", "old"));
  pages.Take({});
  const auto old = pages.Find("/");
  pages.Take(Put("/", "newer"));
  pages.Take({});
  EXPECT_EQ(old->Body, "old");
  EXPECT_EQ(pages.Find("/")->Body, "newer");
  EXPECT_NE(pages.Find("/")->Tag, old->Tag);
  EXPECT_EQ(pages.Bytes(), 5U);
}

TEST(PagesInMemory, GoWhenTheyAreRemoved) {
  ServedPages pages;
  pages.Take(Put("/", "a"));
  pages.Take({});
  pages.Take({.Order = PageOrder::Remove, .Path = "/", .Body = ""});
  pages.Take({.Order = PageOrder::Remove, .Path = "/never", .Body = ""});
  EXPECT_NE(pages.Find("/"), nullptr);
  EXPECT_TRUE(pages.Take({}));
  EXPECT_EQ(pages.Find("/"), nullptr);
  EXPECT_EQ(pages.Bytes(), 0U);
}

TEST(PagesInMemory, HaveTheTypesOfTheirPaths) {
  ServedPages pages;
  for (const char* path : {"/", "/style.css", "/follow.js", "/now"}) {
    pages.Take(Put(path, "a"));
  }
  pages.Take({});
  EXPECT_STREQ(pages.Find("/")->Type, "text/html; charset=utf-8");
  EXPECT_STREQ(pages.Find("/style.css")->Type, "text/css; charset=utf-8");
  EXPECT_STREQ(pages.Find("/follow.js")->Type, "text/javascript; charset=utf-8");
  EXPECT_STREQ(pages.Find("/now")->Type, "text/plain; charset=utf-8");
}

TEST(PagesInMemory, HaveLimits) {
  ServedPages pages;
  const std::string large(LongestPageBody, 'x');
  for (std::size_t at = 0; at < MostPageBytes / LongestPageBody; ++at) {
    ASSERT_TRUE(pages.Take(Put("/" + std::to_string(at), large)));
  }
  EXPECT_FALSE(pages.Take(Put("/x", "1")));
  EXPECT_TRUE(pages.Take({}));
  EXPECT_TRUE(pages.Take(Put("/x", "1")));
  EXPECT_FALSE(pages.Take({}));
  EXPECT_EQ(pages.Find("/x"), nullptr);
  EXPECT_EQ(pages.Bytes(), MostPageBytes);
}

}  // namespace
