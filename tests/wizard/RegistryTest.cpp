#include "WizardFixture.h"

namespace {

const OsRegKey ROOT = OS_HKEY_CURRENT_USER;
const char KEY[] = "Software\\OrbitSetupTest\\Registry";

class Registry : public WizardTest {
 protected:
  Registry() { memset(m_value, '?', sizeof m_value); }
  ~Registry() override { wizard.iDeleteRegistryKey(ROOT, "Software\\OrbitSetupTest"); }

  int iWrite(const char* szName, const std::string& value, const char* szType, const char* szKey = KEY) {
    return wizard.iWriteRegistryKey(ROOT, szKey, szName, value.c_str(), szType);
  }
  std::string Read(const char* szName, int iExpected = 0) {
    memset(m_value, '?', sizeof m_value);
    EXPECT_EQ(wizard.iReadRegistryKey(ROOT, KEY, szName, m_value), iExpected) << szName;
    EXPECT_EQ(m_value[512], '?');
    return iExpected ? "" : m_value;
  }
  bool bSetRaw(const char* szName, OsRegType type, const std::string& data) {
    OsRegistryKey key;
    return key.bOpen(ROOT, KEY, OsRegAccess::Create) &&
           key.bSet(szName, type, data.data(), static_cast<long>(data.size()));
  }
  std::string Raw(const char* szName, OsRegType expected) {
    OsRegistryKey key;
    OsRegType type = OsRegType::None;
    char data[2048];
    long lSize = 0;
    EXPECT_TRUE(key.bOpen(ROOT, KEY, OsRegAccess::Read));
    EXPECT_TRUE(key.bQuery(szName, type, data, sizeof data, lSize));
    EXPECT_EQ(type, expected);
    return std::string(data, static_cast<size_t>(lSize));
  }

  char m_value[513];
};

TEST_F(Registry, WrittenAndReadBack) {
  const struct {
    const char *value, *type;
    OsRegType stored;
    std::string data;
    const char* read;
  } CASES[] = {
      {"Grešž", nullptr, OsRegType::String, std::string("Grešž") + '\0', "Grešž"},
      {"", "", OsRegType::String, std::string(1, '\0'), ""},
      {"255", "HEX_VALUE", OsRegType::Dword, std::string("\xff\0\0\0", 4), "ffffffff"},
      {"5", "a HEX_VALUE b", OsRegType::Dword, std::string("\5\0\0\0", 4), "5"},
      {"ff", "HEX_VALUE BIN_VALUE", OsRegType::Dword, std::string("\0\0\0\0", 4), "0"},
      {"200", "HEX_VALUE", OsRegType::Dword, std::string("\xc8\0\0\0", 4), "ffffffc8"},
      {"0a 1b ff ", "BIN_VALUE", OsRegType::Binary, "\x0a\x1b\xff", "0a 1b ff"},
      {"0a 1b ff", "BIN_VALUE", OsRegType::Binary, "\x0a\x1b", "0a 1b"},
      {"0a", "BIN_VALUE", OsRegType::Binary, "", ""},
      {"xy 1 7f ", "BIN_VALUE", OsRegType::Binary, std::string("\0\1", 2), "00 01"},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iWrite("v", test.value, test.type), 0) << test.value;
    EXPECT_EQ(Raw("v", test.stored), test.data) << test.value;
    EXPECT_EQ(Read("v"), test.read) << test.value;
  }
  EXPECT_EQ(Logged(), Lines{});
}

TEST_F(Registry, TheBufferHoldsFiveHundredAndTwelveBytes) {
  EXPECT_EQ(iWrite("fits", std::string(511, 'x'), nullptr), 0);
  EXPECT_EQ(Read("fits"), std::string(511, 'x'));
  EXPECT_EQ(iWrite("long", std::string(512, 'x'), nullptr), 0);
  Read("long", REG_KEY_ERROR);
  ASSERT_TRUE(bSetRaw("binary", OsRegType::Binary, std::string(512, '\x11')));
  EXPECT_EQ(Read("binary").size(), 170u * 3 - 1);
  ASSERT_TRUE(bSetRaw("empty", OsRegType::Dword, ""));
  EXPECT_EQ(Read("empty"), "0");
}

TEST_F(Registry, MissingKeysAndValues) {
  Read("v", REG_KEY_ERROR);
  EXPECT_EQ(Logged(), Lines{});
  ASSERT_EQ(iWrite("w", "1", nullptr), 0);
  Read("v", REG_KEY_ERROR);
  EXPECT_EQ(Logged(), Lines{"INFO: COrbitWizard::iReadRegistryKey -> lResult!=ERROR_SUCCESS -> RegQueryValueEx(v) -> "
                            "return REG_KEY_ERROR"});
  EXPECT_EQ(wizard.iDeleteRegistryValue(ROOT, KEY, "v"), REG_KEY_ERROR);
  EXPECT_EQ(wizard.iDeleteRegistryValue(ROOT, "Software\\OrbitSetupTest\\None", "v"), REG_KEY_ERROR);
  EXPECT_EQ(Logged(), (Lines{"INFO: COrbitWizard::iDeleteRegistryValue -> lResult!=ERROR_SUCCESS -> RegDeleteValue(v) "
                             "-> return REG_KEY_ERROR",
                             "INFO: COrbitWizard::iDeleteRegistryValue -> lResult!=ERROR_SUCCESS -> "
                             "RegOpenKeyEx(Software\\OrbitSetupTest\\None) -> return REG_KEY_ERROR"}));
  EXPECT_EQ(wizard.iDeleteRegistryValue(ROOT, KEY, "w"), 0);
  Read("w", REG_KEY_ERROR);
}

TEST_F(Registry, NamesOfValues) {
  CNCharArray names;
  EXPECT_EQ(wizard.iEnumRegistryKey(ROOT, KEY, names), REG_KEY_ERROR);
  EXPECT_EQ(Logged().size(), 1u);
  iWrite("only", "1", nullptr);
  wizard.iDeleteRegistryValue(ROOT, KEY, "only");
  EXPECT_EQ(wizard.iEnumRegistryKey(ROOT, KEY, names), 0);
  EXPECT_EQ(names.Size(), 0);
  const std::string longName(200, 'n');
  iWrite("one", "1", nullptr);
  iWrite(longName.c_str(), "2", nullptr);
  EXPECT_EQ(wizard.iEnumRegistryKey(ROOT, KEY, names), 0);
  Lines found;
  for (int i = 0; i < names.Size(); i++) found.push_back(names[i]);
  std::sort(found.begin(), found.end());
  EXPECT_EQ(found, (Lines{longName, "one"}));
}

TEST_F(Registry, KeysGoWithTheirSubkeys) {
  EXPECT_EQ(wizard.iDeleteRegistryKey(ROOT, "Software\\OrbitSetupTest\\None"), 0);
  for (const char* szSubkey : {"a", "a\\b", "a\\b\\c", "d"})
    iWrite("v", "1", nullptr, (std::string(KEY) + "\\" + szSubkey).c_str());
  EXPECT_EQ(wizard.iDeleteRegistryKey(ROOT, KEY), 0);
  OsRegistryKey key;
  EXPECT_FALSE(key.bOpen(ROOT, KEY, OsRegAccess::Read));
  EXPECT_TRUE(key.bOpen(ROOT, "Software\\OrbitSetupTest", OsRegAccess::Read));
  EXPECT_EQ(Logged(), Lines{});
}

}  // namespace
