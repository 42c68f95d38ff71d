// The configuration key tree and its text format: writing, reading, round trips, errors.
#include <gtest/gtest.h>

#include <random>
#include <stdexcept>
#include <string>

#include "config/conf_key.h"
#include "config/conf_key_factory.h"

using basic::ConfKeyContentMulti;
using basic::ConfKeyContentString;
using basic::ConfKeyData;
using basic::ConfKeyFactory;
using basic::ConfKeyInterface;
using basic::ConfKeyMulti;

namespace {

ConfKeyMulti make_example_tree() {
  ConfKeyMulti root("root");
  root.set_comment("c");
  ConfKeyData alpha("alpha", "word");
  alpha.set_comment("x");
  root.add_key(alpha);
  ConfKeyData beta("beta");
  ConfKeyContentMulti list;
  for (const char* item : {"1", "2", "3"}) {
    list.add_content(ConfKeyContentString(item));
  }
  beta.set_content(list);
  root.add_key(beta);
  ConfKeyMulti gamma("gamma");
  gamma.add_key(ConfKeyData("delta", "5"));
  root.add_key(gamma);
  return root;
}

std::string write(const ConfKeyInterface& key) {
  std::string text;
  EXPECT_EQ(key.write_to_string(text, 0), 0);
  return text;
}

// Writes a tree back after reading it, so two trees compare by their text.
std::string reread(const std::string& text, int expected_status = 0) {
  ConfKeyFactory factory;
  auto key = factory.create_from_string(text);
  EXPECT_EQ(factory.get_status(), expected_status) << text;
  return key ? write(*key) : std::string("<none>");
}

int parse_status(const std::string& text) {
  ConfKeyFactory factory;
  factory.create_from_string(text);
  return factory.get_status();
}

}  // namespace

TEST(ConfKeyText, WritesTheReferenceExampleByteForByte) {
  const std::string expected =
      "// c\n"
      "root =\n"
      "{\n"
      "   alpha = word\t// x\n"
      "   beta = { 1 2 3 }\n"
      "   gamma =\n"
      "   {\n"
      "      delta = 5\n"
      "   }\n"
      "}";
  EXPECT_EQ(write(make_example_tree()), expected);
}

TEST(ConfKeyText, ReadsTheExampleBackWithoutComments) {
  const ConfKeyMulti tree = make_example_tree();
  ConfKeyFactory factory;
  auto key = factory.create_from_string(write(tree));
  ASSERT_EQ(factory.get_status(), 0);
  auto* root = dynamic_cast<ConfKeyMulti*>(key.get());
  ASSERT_NE(root, nullptr);
  EXPECT_EQ(root->get_comment(), "");
  EXPECT_EQ(root->get_string("alpha"), "word");
  EXPECT_EQ(root->find_key("alpha")->get_comment(), "");
  EXPECT_EQ(root->get_string("gamma/delta"), "5");
  const auto* beta = dynamic_cast<const ConfKeyData*>(root->find_key("beta"));
  ASSERT_NE(beta, nullptr);
  const auto* list = dynamic_cast<const ConfKeyContentMulti*>(&beta->use_content());
  ASSERT_NE(list, nullptr);
  ASSERT_EQ(list->get_nbr_contents(), 3);
  EXPECT_EQ(dynamic_cast<const ConfKeyContentString&>(list->use_content(2)).get_string(), "3");
  // Without comments the text of the tree is a fixed point of read-then-write.
  const std::string once = reread(write(tree));
  EXPECT_EQ(reread(once), once);
}

TEST(ConfKeyText, QuotingKeepsAwkwardTextsIntact) {
  for (const std::string text :
       {"a, b", "ab", "two words", "tab\there", "x=y", "{", "}", "a//b", "", "{ 1 2 }", "cr\rlf", "v\vb\bx"}) {
    ConfKeyMulti root("r");
    root.add_key(ConfKeyData("v", text));
    ConfKeyFactory factory;
    auto key = factory.create_from_string(write(root));
    ASSERT_EQ(factory.get_status(), 0) << text;
    EXPECT_EQ(dynamic_cast<ConfKeyMulti&>(*key).get_string("v"), text);
  }
  ConfKeyData bare("k", "ab");
  EXPECT_EQ(write(bare), "k = ab");
  ConfKeyData quoted("k", "a, b");
  EXPECT_EQ(write(quoted), "k = \"a, b\"");
  ConfKeyData spaced_name("two words", "1");
  EXPECT_EQ(write(spaced_name), "\"two words\" = 1");
}

TEST(ConfKeyText, RandomTreesSurviveTheRoundTrip) {
  std::mt19937 random(1234);
  const std::string alphabet = "abcXYZ09 ,={}/\t_-";
  auto random_text = [&](size_t max) {
    std::string text;
    const size_t n = random() % (max + 1);
    for (size_t i = 0; i < n; ++i) text += alphabet[random() % alphabet.size()];
    return text;
  };
  auto random_name = [&]() {
    std::string name = random_text(6);
    for (char& c : name) if (c == '/') c = '_';
    return name.empty() ? std::string("n") : name;
  };
  for (int round = 0; round < 200; ++round) {
    ConfKeyMulti root(random_name());
    ConfKeyMulti child(random_name());
    for (int i = 0; i < 4; ++i) {
      ConfKeyData data(random_name());
      if (random() % 2 == 0) {
        data.set_content(ConfKeyContentString(random_text(8)));
      } else {
        ConfKeyContentMulti list;
        ConfKeyContentMulti inner;
        inner.add_content(ConfKeyContentString(random_text(3)));
        list.add_content(ConfKeyContentString(random_text(5)));
        list.add_content(inner);
        data.set_content(list);
      }
      (i % 2 == 0 ? root : child).add_key(data);
    }
    root.add_key(child);
    const std::string text = write(root);
    EXPECT_EQ(reread(text), text);
  }
}

TEST(ConfKeyText, ParseErrorsGiveTheirCodes) {
  EXPECT_EQ(parse_status("a = \"open"), basic::kConfLexical);
  EXPECT_EQ(parse_status("a = { b = 1 }\n}"), basic::kConfLexical);
  EXPECT_EQ(parse_status("a =\n{\n b = 1\n"), basic::kConfLexical);
  EXPECT_EQ(parse_status("} a = 1 {"), basic::kConfLexical);
  EXPECT_EQ(parse_status("a = 1\nb = 2"), basic::kConfTokensLeft);
  EXPECT_EQ(parse_status(""), basic::kConfTokensLeft);
  EXPECT_EQ(parse_status("a ="), basic::kConfTokensLeft);  // fewer than three tokens: no key at all
  EXPECT_EQ(parse_status("a = { 1 2 = }"), basic::kConfBadList);
  EXPECT_EQ(parse_status("a = { 1 = }"), basic::kConfBadElement);
  EXPECT_EQ(parse_status("a = { b = 1 c }"), basic::kConfBadMulti);
  EXPECT_EQ(parse_status("a = { b = 1 c = }"), basic::kConfBadElement);
  EXPECT_EQ(parse_status("a = }{"), basic::kConfLexical);
  EXPECT_EQ(parse_status("a/b = 1"), basic::kConfBadElement);
  // Unbalanced braces win whatever else the text holds.
  EXPECT_EQ(parse_status("a = 1\nb = 2 {"), basic::kConfLexical);
}

TEST(ConfKeyText, ErrorAfterTheKeyReturnsItWithTheStatus) {
  ConfKeyFactory factory;
  auto key = factory.create_from_string("a = 1\nb = 2");
  EXPECT_EQ(factory.get_status(), basic::kConfTokensLeft);
  ASSERT_NE(key, nullptr);
  EXPECT_EQ(key->get_name(), "a");
  auto none = factory.create_from_string("a = \"x");
  EXPECT_EQ(none, nullptr);
  EXPECT_TRUE(factory.get_tokens().empty());
}

TEST(ConfKeyText, CommentsAndQuotedMarksAreLexedAsSpecified) {
  ConfKeyFactory factory;
  auto key = factory.create_from_string("r = // the root\n{\n x = \"a // b = { }\" // dropped\n y = \"\"\n}");
  ASSERT_EQ(factory.get_status(), 0);
  auto& root = dynamic_cast<ConfKeyMulti&>(*key);
  EXPECT_EQ(root.get_string("x"), "a // b = { }");
  EXPECT_EQ(root.get_string("y"), "");
  ASSERT_NE(root.find_key("y"), nullptr);
  // A data key holding an empty list.
  auto empty = factory.create_from_string("x = { }");
  ASSERT_EQ(factory.get_status(), 0);
  const auto* data = dynamic_cast<const ConfKeyData*>(empty.get());
  ASSERT_NE(data, nullptr);
  EXPECT_EQ(dynamic_cast<const ConfKeyContentMulti&>(data->use_content()).get_nbr_contents(), 0);
}

TEST(ConfKeyText, DeepNestingIsRefusedNotRecursedInto) {
  std::string text = "a = ";
  for (int i = 0; i < 5000; ++i) text += "{ ";
  for (int i = 0; i < 5000; ++i) text += "} ";
  EXPECT_EQ(parse_status(text), basic::kConfBadElement);
  std::string shallow = "a = ";
  for (int i = 0; i < 50; ++i) shallow += "{ ";
  for (int i = 0; i < 50; ++i) shallow += "} ";
  EXPECT_EQ(parse_status(shallow), 0);
}

TEST(ConfKeyTree, NamesPathsAndLookups) {
  EXPECT_THROW(ConfKeyData("a/b"), std::runtime_error);
  EXPECT_THROW(ConfKeyMulti("a\\b"), std::runtime_error);
  try {
    ConfKeyData key("ok");
    key.set_name("x//y");
    FAIL();
  } catch (const std::runtime_error& error) {
    EXPECT_STREQ(error.what(), "basic::ConfKeyInterface::check_name_throw() : Invalid name.");
  }
  EXPECT_EQ(ConfKeyInterface::make_valid_name("Brak morph-1.2/x"), "Brak_morph_1_2_x");

  ConfKeyMulti midi("MIDI");
  ConfKeyMulti cc("CC");
  cc.add_key(ConfKeyData("3", "three"));
  midi.add_key(cc);
  ConfKeyMulti top("top");
  top.add_key(midi);
  const ConfKeyInterface* found = top.find_key("MIDI\\CC/3");
  ASSERT_NE(found, nullptr);
  EXPECT_EQ(top.get_string("MIDI\\CC/3"), "three");
  EXPECT_EQ(top.find_key("MIDI/CC/4"), nullptr);
  EXPECT_EQ(top.find_key("MIDI/CC/3/deeper"), nullptr);
  EXPECT_EQ(top.find_key("midi/CC/3"), nullptr);  // case-sensitive
  try {
    top.find_key("/MIDI");
    FAIL();
  } catch (const std::runtime_error& error) {
    EXPECT_STREQ(error.what(), "basic::ConfKeyMulti::split_key_path_first() : Invalid key path.");
  }
  const auto parts = ConfKeyMulti::split_key_path_first("a\\b/c");
  EXPECT_EQ(parts.first, "a");
  EXPECT_EQ(parts.second, "b/c");

  EXPECT_EQ(top.find_multi("MIDI"), 0);
  EXPECT_EQ(top.find_multi("MIDI", 1), -1);
  top.add_key(ConfKeyData("leaf", "1"));
  EXPECT_EQ(top.find_multi("leaf"), -1);
}

TEST(ConfKeyTree, SetKeyReplacesInPlaceAndClonesAreDeep) {
  ConfKeyMulti root("r");
  root.add_key(ConfKeyData("a", "1"));
  root.add_key(ConfKeyData("b", "2"));
  root.set_key(ConfKeyData("a", "3"));
  root.set_key(ConfKeyData("c", "4"));
  ASSERT_EQ(root.get_nbr_keys(), 3);
  EXPECT_EQ(root.use_key(0).get_name(), "a");
  EXPECT_EQ(root.get_string("a"), "3");
  EXPECT_EQ(root.use_key(2).get_name(), "c");

  auto copy = root.clone();
  root.set_key(ConfKeyData("a", "changed"));
  EXPECT_EQ(dynamic_cast<ConfKeyMulti&>(*copy).get_string("a"), "3");
}

TEST(ConfKeyTree, AnonymousKeysCannotBeWritten) {
  ConfKeyMulti root("r");
  root.add_key(ConfKeyData("", "x"));
  std::string text;
  try {
    root.write_to_string(text, 0);
    FAIL();
  } catch (const std::runtime_error& error) {
    EXPECT_STREQ(error.what(), "basic::ConfKeyInterface::do_write_to_string() : Key can't be anonymous.");
  }
}
