// The modules of the translator's interpreter: the statically linked
// natives and the "stdint" 64-bit values the JSON reader relies on.
#include <gtest/gtest.h>

#include <lua.hpp>

#include <functional>
#include <string>

#include "errors/translator/Translator.h"
#include "errors/translator/TranslatorSession.h"

namespace hsdig::translator {
namespace {

class LuaModules : public testing::Test {
 protected:
  // Runs `chunk`, which returns one value, and gives it as text (or the error).
  std::string eval(const std::string& chunk) {
    lua_State* L = translator.state();
    int top = lua_gettop(L);
    std::string out;
    if (luaL_loadstring(L, chunk.c_str()) != 0 || lua_pcall(L, 0, 1, 0) != 0) {
      out = std::string("error: ") + lua_tostring(L, -1);
    } else {
      lua_getglobal(L, "tostring");
      lua_insert(L, -2);
      lua_call(L, 1, 1);
      out = lua_tostring(L, -1);
    }
    lua_settop(L, top);
    return out;
  }
  Translator translator{kTranslatorSettings, "/nonexistent"};
};

TEST_F(LuaModules, NativeModulesAreLinkedIn) {
  EXPECT_EQ(eval("return require('cjson').encode({a = 1})"), R"({"a":1})");
  EXPECT_EQ(eval("return type(require('lfs').attributes)"), "function");
  EXPECT_EQ(eval("return type(require('stdint').int64)"), "function");
  EXPECT_EQ(eval("return require('cvmxl_utilities').languageCode(7)"), "zzz");
  EXPECT_EQ(eval("return require('cvmxl_utilities').languageCode(5)"), "chs");
}

// Inside someone else's process the interpreter neither writes to the
// console nor ends or spawns processes.
TEST_F(LuaModules, ScriptsCannotReachTheConsoleOrEndTheProcess) {
  EXPECT_EQ(eval("print('must not appear') io.write('nor this') return io.read('*l')"), "nil");
  EXPECT_EQ(eval("return io.stderr:write('discarded') ~= nil"), "true");
  EXPECT_EQ(
      eval("return tostring(os.exit) .. ' ' .. tostring(os.execute) .. ' ' .. tostring(io.popen)"),
      "nil nil nil");
}

TEST_F(LuaModules, StdintArithmeticAndComparison) {
  struct Case {
    const char* expression;
    const char* expected;
  };
  const Case cases[] = {
      {"s.int64('9223372036854775807')", "9223372036854775807"},
      {"s.int64('-9223372036854775808')", "-9223372036854775808"},
      {"s.uint64('0xFFFFFFFFFFFFFFFF')", "18446744073709551615"},
      {"s.int64('9007199254740993') + 1", "9007199254740994"},
      {"s.int64(5) - 7", "-2"},
      {"s.uint64(5) - 7", "18446744073709551614"},
      {"s.int64(3) * s.int64('3000000000')", "9000000000"},
      {"s.int64(-7) / 2", "-3"},
      {"s.int64(-7) % 2", "-1"},
      {"-s.int64(4)", "-4"},
      {"s.int64(1) < s.int64(2)", "true"},
      {"s.int64(-1) < s.uint64(0)", "true"},
      {"s.uint64('18446744073709551615') <= s.int64(1)", "false"},
      {"s.int64(2) == s.int64(2)", "true"},
      {"s.tohex(s.int64(-1), 8)", "FFFFFFFFFFFFFFFF"},
      {"s.tohex(255, 8)", "000000FF"},
      {"'v=' .. s.int64(12)", "v=12"},
      {"s.tonumber(s.int64(1024))", "1024"},
      {"s.int64(1) / 0", "error: stdint: division by zero"},
      {"s.int64('-9223372036854775808') / -1", "error: stdint: overflow in division"},
      {"s.int64('12x')", "error: stdint: not an integer: 12x"},
      {"s.int64('-9223372036854775809')", "error: stdint: not an integer: -9223372036854775809"},
      {"s.int64(2^64)", "error: stdint: number out of the 64-bit range"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.expression);
    std::string result = eval(std::string("local s = require('stdint') return ") + c.expression);
    // Errors carry the chunk position in front of the message.
    if (result.rfind("error: ", 0) == 0) {
      EXPECT_NE(result.find(c.expected + 7), std::string::npos) << result;
    } else {
      EXPECT_EQ(result, c.expected);
    }
  }
}

TEST_F(LuaModules, JsonReaderKeepsLargeIntegersExactAndRefusesBadInput) {
  struct Case {
    const char* json;
    const char* expression;  // over `v`, the decoded value
    const char* expected;
  };
  const Case cases[] = {
      {R"({"a":[1,2,3]})", "#v.a", "3"},
      {R"("\u00e9\ud83d\ude00")", "v", "\xC3\xA9\xF0\x9F\x98\x80"},
      {R"(-9007199254740993)", "v", "-9007199254740993"},
      {R"(18446744073709551615)", "v", "18446744073709551615"},
      {R"(1e400)", "v", "inf"},
      {R"([null])", "v[1] == require('json').null", "true"},
      {R"({"a":1,})", "v", "error"},
      {R"([1 2])", "v", "error"},
      {R"("abc)", "v", "error"},
      {R"({"a":1} x)", "v", "error"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.json);
    std::string chunk = std::string("local json = require('json') local v = json.decode([==[") +
                        c.json + "]==]) return " + c.expression;
    std::string result = eval(chunk);
    if (std::string(c.expected) == "error") {
      EXPECT_EQ(result.rfind("error: json: ", 0), 0u) << result;
    } else {
      EXPECT_EQ(result, c.expected);
    }
  }
}

}  // namespace
}  // namespace hsdig::translator

namespace hsdig::translator {
namespace {

TEST(TranslatorCreation, FailuresNameTheStepAndRecordTheScriptError) {
  struct Case {
    const char* name;
    const char* settings;
    const char* message;
    bool luaRecord;  // an internal-error record with "api" "lua"
  };
  const Case cases[] = {
      {"settings without a translator name", R"({"cvxlatorlua_settings":{}})",
       "could not find translator key in json", false},
      {"settings that are not JSON", "{", "could not find translator key in json", false},
      {"a translator script that does not exist", R"({"cvxlatorlua_xlator":"no_such_script"})",
       "lua setupEnv failed", true},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    try {
      Translator translator(c.settings, "/nonexistent");
      ADD_FAILURE() << "created";
    } catch (const TranslationFailure& failure) {
      EXPECT_STREQ(failure.what(), c.message);
      EXPECT_EQ(failure.code(), kCodeInternal);
      const auto& doc = failure.status().description();
      bool hasLua = doc.IsObject() && doc.HasMember("internal_error") &&
                    std::string(doc["internal_error"][0]["api"].GetString()) == "lua";
      EXPECT_EQ(hasLua, c.luaRecord);
      if (hasLua) {
        EXPECT_NE(
            std::string(doc["internal_error"][0]["string"].GetString()).find("no_such_script"),
            std::string::npos);
      }
    }
  }
}

TEST(TranslatorCreation, ATranslatorWithoutOperationsSaysSo) {
  // A module that loads but offers neither operation.
  Translator translator(R"({"cvxlatorlua_xlator":"cvmxl_utilities"})", "/nonexistent");
  struct Case {
    const char* name;
    std::function<void()> call;
    const char* message;
  };
  const Case cases[] = {
      {"static", [&] { translator.getStaticDesc(1, 0, 0); },
       "xlator doesn't support getStaticDesc"},
      {"dynamic", [&] { translator.getDynamicDesc("{}", 0, 0, "json1"); },
       "xlator doesn't support getDynamicDesc"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    try {
      c.call();
      ADD_FAILURE() << "succeeded";
    } catch (const TranslationFailure& failure) {
      EXPECT_STREQ(failure.what(), c.message);
    }
  }
}

}  // namespace
}  // namespace hsdig::translator
