#include "host/recording/RecordingJournal.h"

#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <thread>

namespace quarn::test {
namespace {

using namespace std::chrono_literals;
using testing::HasSubstr;
using testing::SizeIs;

JournalHead head() {
    return {"Häuschen \"2\"",
            {"host-1", 4711, 123456789012345ULL},
            {"quarn 1.0.0", "00000000000000d0", "00000000000000e0", "avx2"},
            1.25};
}

JournalFrame frame(int number) {
    FrameCamera camera;
    camera.place = {1.5, -2.0, 3.0};
    camera.up = {0.0, 0.0, 1.0};
    camera.lens_mm = 50.0;
    return {{number, "Häuschen \"2\"00" + std::to_string(number) + ".jpg", 84147,
             0xE2C1B607FE03FF41ULL, camera, std::nullopt},
            0.5};
}

RecordingJournal read(const std::filesystem::path& file) {
    JournalReader reader(file);
    EXPECT_TRUE(reader.readOn().ok());
    return reader.content();
}

class JournalOnDisk : public testing::Test {
protected:
    JournalWriter create() const {
        return std::move(JournalWriter::create(folder.path(), head()).value());
    }
    const TempFolder folder;
};

TEST_F(JournalOnDisk, ReadsBackWhatWasWritten) {
    JournalWriter writer = create();
    ASSERT_TRUE(writer.add(frame(3)).ok());
    ASSERT_TRUE(writer.add(frame(1)).ok());
    writer.end("Häuschen is gone.");
    EXPECT_EQ(read(writer.file()),
              (RecordingJournal{head(), {frame(3), frame(1)}, true, "Häuschen is gone."}));
    EXPECT_THAT(journalsIn(folder.path(), head().animation), testing::ElementsAre(writer.file()));
    EXPECT_THAT(journalsIn(folder.path(), "other"), testing::IsEmpty());
}

TEST_F(JournalOnDisk, ReadsOnWhereItEnded) {
    JournalWriter writer = create();
    JournalReader reader(writer.file());
    ASSERT_TRUE(reader.readOn().ok());
    EXPECT_THAT(reader.content().frames, SizeIs(0));
    ASSERT_TRUE(writer.add(frame(1)).ok());
    ASSERT_TRUE(reader.readOn().ok());
    ASSERT_TRUE(reader.readOn().ok());
    EXPECT_THAT(reader.content().frames, SizeIs(1));
}

TEST_F(JournalOnDisk, LeavesALineThatIsNotWhole) {
    const std::string text = journalHeadLine(head()) + journalFrameLine(frame(1));
    const std::string line = journalFrameLine(frame(2));
    const std::filesystem::path file = folder / "x.journal";
    for (std::size_t length = 0; length < line.size(); ++length) {
        writeFile(file, text + line.substr(0, length));
        EXPECT_THAT(read(file).frames, SizeIs(1)) << length;
    }
    writeFile(file, text + line);
    EXPECT_THAT(read(file).frames, SizeIs(2));
}

TEST_F(JournalOnDisk, ThatIsSomethingElseOrDamagedIsToldWithItsName) {
    const std::string good = journalHeadLine(head()) + journalFrameLine(frame(1));
    const auto replaced = [&](const std::string& part, const std::string& by) {
        std::string text = good;
        text.replace(text.find(part), part.size(), by);
        return text;
    };
    for (const std::string& text :
         {std::string("notes\n"), std::string("{}\n"), replaced("quarn-journal", "another"),
          replaced("\"version\":1", "\"version\":2"), replaced("4711", "-1"),
          replaced("84147", "\"84147\""), replaced("e2c1b607fe03ff41", "xyz"),
          replaced("\"frame\":1", "\"frame\":-1"), replaced("00" + std::string("1.jpg"), "/etc"),
          replaced("\"seconds\":0.5", "\"seconds\":1e999"), std::string("\n"),
          std::string(100000, '[') + "\n"}) {
        JournalReader reader(folder / "house.journal");
        const auto taken = reader.take(text);
        ASSERT_FALSE(taken.ok()) << text;
        EXPECT_THAT(taken.message(), HasSubstr("house.journal"));
    }
    JournalReader gone(folder / "gone.journal");
    EXPECT_FALSE(gone.readOn().ok());
}

TEST_F(JournalOnDisk, CountsAsAliveUntilItsWriterEndsOrDoesNotRenewIt) {
    JournalHead far = head();
    far.writer = {"far-away", 7, 0};
    JournalWriter writer = std::move(JournalWriter::create(folder.path(), far).value());
    JournalReader reader(writer.file());
    ASSERT_TRUE(reader.readOn().ok());
    const auto now = writer.renew();
    EXPECT_TRUE(isWriterAlive(reader, now, 60s));
    EXPECT_TRUE(isWriterAlive(reader, now + 59s, 60s));
    EXPECT_FALSE(isWriterAlive(reader, now + 61s, 60s));
    writer.end("");
    ASSERT_TRUE(reader.readOn().ok());
    EXPECT_FALSE(isWriterAlive(reader, now, 60s));
}

TEST_F(JournalOnDisk, OfAProcessThatHasEndedOnThisMachineIsNotAlive) {
    JournalHead here = head();
    here.writer = {hostName(), 1, 987654321};
    const JournalWriter writer = std::move(JournalWriter::create(folder.path(), here).value());
    JournalReader reader(writer.file());
    ASSERT_TRUE(reader.readOn().ok());
    EXPECT_FALSE(isWriterAlive(reader, writer.renew(), 60s));
}

TEST_F(JournalOnDisk, CannotBeMadeInAFolderThatIsNotThere) {
    const auto made = JournalWriter::create(folder / "gone", head());
    ASSERT_FALSE(made.ok());
    EXPECT_THAT(made.message(), HasSubstr("cannot be written"));
}

} // namespace
} // namespace quarn::test
