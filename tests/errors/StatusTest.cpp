// The Status replacement rule, its source locations, value semantics, and the
// exceptions that carry a Status or a driver code.
#include <gtest/gtest.h>

#include <cstring>

#include "errors/Exception.h"
#include "errors/Status.h"

namespace hsdig {
namespace {

constexpr int32_t kWarning = 0x3FFA4001;
constexpr int32_t kOtherWarning = 0x3FFA4002;
constexpr int32_t kError = -1074097790;
constexpr int32_t kOtherError = -52003;

TEST(Status, ReplacementRule) {
  struct Case {
    const char* name;
    int32_t held;
    int32_t incoming;
    bool replaced;
  };
  const Case cases[] = {
      {"success takes a warning", 0, kWarning, true},
      {"success takes an error", 0, kError, true},
      {"success ignores success", 0, 0, false},
      {"a warning gives way to an error", kWarning, kError, true},
      {"a warning keeps against another warning", kWarning, kOtherWarning, false},
      {"a warning keeps against success", kWarning, 0, false},
      {"an error is never replaced by an error", kError, kOtherError, false},
      {"an error is never replaced by a warning", kError, kWarning, false},
      {"an error is never cleared by success", kError, 0, false},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    Status s;
    s.set(c.held);
    EXPECT_EQ(s.set(c.incoming), c.replaced);
    EXPECT_EQ(s.code(), c.replaced ? c.incoming : c.held);
    EXPECT_EQ(Status::replaces(c.held, c.incoming), c.replaced);
  }
}

TEST(Status, RecordsTheSetterOnlyWhenItReplaces) {
  Status s;
  EXPECT_FALSE(s.hasDescription());
  int firstLine = __LINE__ + 1;
  s.set(kWarning);
  ASSERT_TRUE(s.hasDescription());
  EXPECT_STREQ(s.description()["component"].GetString(), "hsdigRemote");
  EXPECT_STREQ(s.description()["file"].GetString(), "StatusTest.cpp");
  EXPECT_EQ(s.description()["line"].GetInt(), firstLine);

  s.set(kOtherWarning);  // refused: the location stays the first setter's
  EXPECT_EQ(s.description()["line"].GetInt(), firstLine);

  int errorLine = __LINE__ + 1;
  s.set(kError, std::source_location::current(), "(driverCallReturnCode)");
  EXPECT_EQ(s.description()["line"].GetInt(), errorLine);
  EXPECT_STREQ(s.description()["expression"].GetString(), "(driverCallReturnCode)");
  EXPECT_EQ(s.description().MemberCount(), 4u) << "members are replaced, not repeated";
}

TEST(Status, CopiesAreDeepAndMovesLeaveSuccess) {
  Status a(kError);
  Status b = a;
  b.description().AddMember("extra", 1, b.description().GetAllocator());
  EXPECT_FALSE(a.description().HasMember("extra"));
  EXPECT_EQ(b.code(), kError);

  Status c;
  c = b;
  EXPECT_TRUE(c.description().HasMember("extra"));
  c = c;  // self-assignment keeps the value
  EXPECT_TRUE(c.description().HasMember("extra"));

  Status d = std::move(c);
  EXPECT_EQ(d.code(), kError);
  EXPECT_EQ(c.code(), 0);
  EXPECT_TRUE(d.description().HasMember("extra"));

  d.reset();
  EXPECT_EQ(d.code(), 0);
  EXPECT_FALSE(d.hasDescription());
  EXPECT_EQ(d.descriptionJson(), "");
}

TEST(Status, DescriptionJsonRoundTrip) {
  Status s(kError);
  std::string json = s.descriptionJson();
  EXPECT_NE(json.find("\"component\":\"hsdigRemote\""), std::string::npos);
  Status t;
  EXPECT_TRUE(t.setDescriptionJson(json));
  EXPECT_EQ(t.descriptionJson(), json);
  EXPECT_FALSE(t.setDescriptionJson("[1,2]"));
  EXPECT_FALSE(t.setDescriptionJson("{\"unterminated\":"));
  EXPECT_EQ(t.descriptionJson(), json) << "a refused text leaves the description";
}

TEST(Exception, CarriesTheStatusWithItsThrowSite) {
  int line = 0;
  try {
    line = __LINE__ + 1;
    throw Exception(kOtherError);
  } catch (const ExceptionBase& e) {
    EXPECT_EQ(e.status().code(), kOtherError);
    EXPECT_EQ(e.status().description()["line"].GetInt(), line);
    EXPECT_NE(std::strstr(e.what(), "-52003"), nullptr);
  }
}

TEST(Exception, FromAStatusKeepsItsDescriptionAndAddsAMissingThrowSite) {
  Status located(kError);
  int locatedLine = located.description()["line"].GetInt();
  Exception keeps(located);
  EXPECT_EQ(keeps.status().description()["line"].GetInt(), locatedLine);

  // A status whose description carries no location (replaced wholesale).
  Status withCode(kError);
  withCode.setDescriptionJson("{\"translator\":\"mxlator_hsdig\"}");
  int line = __LINE__ + 1;
  Exception adds(withCode);
  EXPECT_EQ(adds.status().code(), kError);
  EXPECT_EQ(adds.status().description()["line"].GetInt(), line);
  EXPECT_STREQ(adds.status().description()["translator"].GetString(), "mxlator_hsdig");
}

TEST(Exception, ThrowIfErrorThrowsOnlyOnErrors) {
  EXPECT_NO_THROW(throwIfError(0));
  EXPECT_NO_THROW(throwIfError(kWarning));
  EXPECT_THROW(throwIfError(kError), Exception);
}

TEST(HostErrorException, OwnsItsTextAndReadsAnAbsentTextAsEmpty) {
  std::string source = "overload on channel 0";
  HostErrorException e(kError, source.c_str());
  source.assign(source.size(), 'x');
  EXPECT_EQ(e.text(), "overload on channel 0");
  EXPECT_STREQ(e.what(), "overload on channel 0");
  EXPECT_EQ(e.code(), kError);

  HostErrorException empty(kError, static_cast<const char*>(nullptr));
  EXPECT_EQ(empty.text(), "");

  HostErrorException copy = e;
  EXPECT_EQ(copy.text(), e.text());
  EXPECT_NE(copy.what(), e.what()) << "a copy owns its own text";
}

}  // namespace
}  // namespace hsdig
