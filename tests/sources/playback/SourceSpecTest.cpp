// The words that name a source, with their options.
#include <chrono>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/playback/SourceSpec.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::PlaybackOptions;
using sources::SourceSpec;

TEST(SourceSpec, ReadsAScenarioWithItsSeed) {
  EXPECT_EQ(SourceSpec::parse("scenario")->seed, 1U);
  EXPECT_EQ(SourceSpec::parse("scenario:seed=18446744073709551615")->seed, 18446744073709551615U);
  const auto spec = SourceSpec::parse("scenario:seed=7,speed=2.5,start=90");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->kind, SourceSpec::Kind::scenario);
  EXPECT_EQ(spec->seed, 7U);
  EXPECT_EQ(spec->playback.speed, 2.5);
  EXPECT_EQ(spec->playback.start, 90s);
  EXPECT_EQ(SourceSpec::parse("scenario,speed=max")->playback.speed, PlaybackOptions::maximum);
}

TEST(SourceSpec, ReadsAFileWithItsOptions) {
  const auto spec = SourceSpec::parse("replay:/tmp/a b:c.pcap,loop,speed=10,start=1.5,gaps=real");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->kind, SourceSpec::Kind::replay);
  EXPECT_EQ(spec->file, "/tmp/a b:c.pcap");
  EXPECT_TRUE(spec->playback.loop);
  EXPECT_TRUE(spec->playback.realGaps);
  EXPECT_EQ(spec->playback.speed, 10);
  EXPECT_EQ(spec->playback.start, 1500ms);
  EXPECT_EQ(SourceSpec::parse("diag:-")->file, "-");
  EXPECT_FALSE(SourceSpec::parse("diag:x")->playback.loop);
  EXPECT_EQ(SourceSpec::parse("modemmanager")->kind, SourceSpec::Kind::modemManager);
  for (const char* port : {"/dev/ttyUSB0", "tcp:127.0.0.1:5000"}) {
    const auto live = SourceSpec::parse(std::string("diag:") + port);
    ASSERT_TRUE(live) << port;
    EXPECT_EQ(live->kind, SourceSpec::Kind::diagPort);
    EXPECT_EQ(live->file, port);
    EXPECT_TRUE(live->isLive());
    EXPECT_FALSE(SourceSpec::parse(std::string("diag:") + port + ",loop"));
  }
  for (const char* file : {"-", "/dev/stdin", "/dev/fd/3", "dev/ttyUSB0", "tcp"}) {
    EXPECT_EQ(SourceSpec::parse(std::string("diag:") + file)->kind, SourceSpec::Kind::diag) << file;
  }
}

TEST(SourceSpec, ReadsTheSimCardOfRecordingsAndOfALogPort) {
  for (const char* words : {"diag:log", "replay:capture.pcap", "diag:/dev/ttyUSB0", "diag:tcp:127.0.0.1:5000"}) {
    const auto spec = SourceSpec::parse(std::string(words) + ",sim=2");
    ASSERT_TRUE(spec) << spec.reason();
    EXPECT_EQ(spec->sim, 2) << words;
    EXPECT_EQ(SourceSpec::parse(words)->sim, std::nullopt) << words;
  }
}

TEST(SourceSpec, TakesTwoCommasAsOneOfAFilesName) {
  const auto spec = SourceSpec::parse("replay:a,,b,,,loop");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->file, "a,b,");
  EXPECT_TRUE(spec->playback.loop);
}

TEST(SourceSpec, RefusesWordsWithoutAMeaningAndSaysWhy) {
  const std::vector<std::pair<std::string, std::string>> table = {
      {"", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"radio", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"Scenario", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"replay", "it names no file"},
      {"replay:", "it names no file"},
      {"replay,loop", "it names no file"},
      {"diag:,loop", "it names no file"},
      {"scenario:", "there is no option \"\""},
      {"scenario:seed=", "seed is a whole number, not negative"},
      {"scenario:seed=-1", "seed is a whole number, not negative"},
      {"scenario:seed=1x", "seed is a whole number, not negative"},
      {"scenario:seed=1,seed=2", "seed is given twice"},
      {"scenario,loop", "there is no option \"loop\""},
      {"scenario,gaps=real", "there is no option \"gaps=real\""},
      {"replay:f,seed=1", "there is no option \"seed=1\" (a comma in a file's name is written twice)"},
      {"replay:f,loop=1", "there is no option \"loop=1\" (a comma in a file's name is written twice)"},
      {"replay:f,speed=0", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=-1", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=nan", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=inf", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=fast", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,start=-1", "start is a number of seconds, not negative"},
      {"replay:f,start=1e300", "start is a number of seconds, not negative"},
      {"replay:f,gaps=none", "gaps can only be real"},
      {"replay:f,loop,loop", "loop is given twice"},
      {"modemmanager,speed=2", "a live modem takes no options"},
      {"modemmanager:0", "a live modem takes no options"},
      {"diag:/dev/ttyUSB0,speed=2", "a live modem takes no options but sim"},
      {"scenario:sim=1", "the simulated phone has one SIM card"},
      {"modemmanager,sim=1", "ModemManager reports one SIM card, the active one"},
      {"diag:f,sim=", "sim is the number of a SIM card, from 1 to 4"},
      {"diag:f,sim=0", "sim is the number of a SIM card, from 1 to 4"},
      {"replay:f,sim=5", "sim is the number of a SIM card, from 1 to 4"},
      {"diag:tcp:127.0.0.1:1,sim=two", "sim is the number of a SIM card, from 1 to 4"},
      {"replay:f,sim=1,sim=2", "sim is given twice"},
  };
  for (const auto& [words, reason] : table) {
    SCOPED_TRACE(words);
    const auto spec = SourceSpec::parse(words);
    ASSERT_FALSE(spec.ok());
    EXPECT_EQ(spec.reason(), "source \"" + words + "\": " + reason);
  }
}

}  // namespace
}  // namespace vespscope::test
