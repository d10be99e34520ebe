// Captures and modem logs are distinguished by their contents.
#include <sys/stat.h>

#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "capture/CaptureWriter.h"
#include "sources/RecogniseFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using sources::FileKind;
using sources::recogniseFile;

std::string writeCapture(const TemporaryFolder& folder, const std::string& name) {
  auto writer = capture::CaptureWriter::create(folder / name, capture::Flushing::inBlocks);
  EXPECT_TRUE(writer && !writer->write({0x3C4E04, 0, {1}, {}}) && !writer->flush());
  return folder / name;
}

TEST(RecogniseFile, GoesByTheContents) {
  const TemporaryFolder folder;
  // A record of an unknown code.
  const std::string log("\x10\x00\x0c\x00\x0c\x00\xfe\xff\x00\x00\x01\x00\x00\x00\x00\x00\xea\xa9\x7e", 19);
  EXPECT_EQ(*recogniseFile(writeCapture(folder, "a.qmdl")), FileKind::capture);
  EXPECT_EQ(*recogniseFile(folder.write("b.pcap", log)), FileKind::modemLog);
  EXPECT_EQ(*recogniseFile(folder.path().string()), FileKind::capture);
  EXPECT_TRUE(sources::isModemLog(folder / "b.pcap"));
  EXPECT_FALSE(sources::isModemLog(folder / "a.qmdl"));
}

TEST(RecogniseFile, NamesWhatIsNeither) {
  const TemporaryFolder folder;
  EXPECT_EQ(recogniseFile(folder / "none").reason(),
            (folder / "none") + ": cannot be opened: No such file or directory");
  EXPECT_EQ(recogniseFile(folder.write("letter", "Dear reader")).reason(),
            (folder / "letter") + ": neither a capture nor a modem log: it is text");
  EXPECT_EQ(recogniseFile(folder.write("noise", std::string(64, '\x80'))).reason(),
            (folder / "noise") + ": neither a capture nor a modem log");
  EXPECT_EQ(recogniseFile(folder.write("empty", "")).reason(), (folder / "empty") + ": is empty");
  ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_EQ(recogniseFile(folder / "pipe").reason(),
            (folder / "pipe") + ": is a pipe, not a file; read it through standard input (-)");
}

TEST(RecogniseFile, WritesACommaOfANameTwice) {
  EXPECT_EQ(sources::sourceWords(FileKind::capture, "a,b.pcap"), "replay:a,,b.pcap");
  EXPECT_EQ(sources::sourceWords(FileKind::modemLog, "a.mi2log"), "diag:a.mi2log");
}

}  // namespace
}  // namespace vespscope::test
