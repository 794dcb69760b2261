// SPDX-License-Identifier: MIT
// What the next open or save does with the copy that an interrupted rewrite in place kept: the old
// bytes go back only into the file they came from, and only over a state the rewrite can leave.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <filesystem>
#include <linux/fs.h>
#include <sys/file.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include "KeepFile.h"
#include "NewFile.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string Old = "0 old header line\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
const std::string New = "0 new\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n0 // a longer new text\r\n";

class InterruptedSave : public ::testing::Test {
protected:
    // Leaves the keep file a rewrite of the part from Old to New makes, as a kill would, and
    // puts current in the part, in place.
    void interruptedWith(const std::string& current)
    {
        {
            KeepFile keep(*part, Old, {New}, home.path().string());
            keep.keep();
        }
        const FileDescriptor writable = part->openForWriting();
        ASSERT_EQ(::ftruncate(writable.get(), 0), 0);
        ASSERT_EQ(::pwrite(writable.get(), current.data(), current.size(), 0), static_cast<ssize_t>(current.size()));
    }
    std::string keepName() const
    {
        const auto id = part->identity();
        return ".quillmark-keep-" + std::to_string(id.device) + "-" + std::to_string(id.inode);
    }
    KeepFinding::State restoreFinding()
    {
        return RestoreInterruptedSave(*part, nullptr, {}, home.path().string()).state;
    }
    bool restore() { return restoreFinding() == KeepFinding::State::Restorable; }

    TempDir dir, home;
    const std::string path = dir.write("a.dat", Old);
    std::shared_ptr<OpenPart> part = OpenPart::openPath(path);
};

TEST_F(InterruptedSave, EveryStateTheRewriteLeavesGetsTheOldBytesBack)
{
    const std::string states[] = {New.substr(0, 5) + Old.substr(5), New.substr(0, Old.size()),
                                  New.substr(0, Old.size() + 3)};
    for (const auto& torn : states) {
        interruptedWith(torn);
        EXPECT_TRUE(restore());
        EXPECT_EQ(ReadBytes(path), Old);
        EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"a.dat"}) << "the keep file goes";
    }
}

TEST_F(InterruptedSave, ARewriteThatEndedStays)
{
    interruptedWith(New);
    EXPECT_FALSE(restore());
    EXPECT_EQ(ReadBytes(path), New);
    EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"a.dat"});
}

// The user wrote the part again after the kill: the part is left alone and the copy stays where
// the message says.
TEST_F(InterruptedSave, APartThatChangedSinceKeepsItsBytesAndTheCopyStays)
{
    interruptedWith("0 the user's own later text\r\n" + std::string(Old.size(), 'x'));
    const auto later = ReadBytes(path);
    try {
        restore();
        ADD_FAILURE() << "no error";
    } catch (const KeepNotRestoredError& error) {
        EXPECT_EQ(error.description(), path +
                                           ": an interrupted save was not restored because the file changed "
                                           "since; its old bytes are in " +
                                           dir.file(keepName()));
    }
    EXPECT_EQ(ReadBytes(path), later);
    EXPECT_TRUE(fs::exists(dir.file(keepName())));
}

// A part that another program cut short after the kill is no state the rewrite leaves, however
// well its bytes match the new text's start and the old text's end.
TEST_F(InterruptedSave, APartShorterThanTheOldBytesIsAChange)
{
    const auto shortened = New.substr(0, 5) + Old.substr(5, Old.size() - 12);
    interruptedWith(shortened);
    EXPECT_THROW(restore(), KeepNotRestoredError);
    EXPECT_EQ(ReadBytes(path), shortened);
}

// The part was deleted after the kill, and a new file got its inode: the copy names the old
// file's birth, which the new one does not share. It never touches the new file nor stops its
// saves.
TEST_F(InterruptedSave, ACopyOfAFileThatIsGoneNeverStopsTheFileOnItsInode)
{
    interruptedWith(New.substr(0, 5) + Old.substr(5)); // as torn as can be
    auto record = ReadBytes(dir.file(keepName()));
    const auto born = std::to_string(part->identity().bornSeconds);
    record.replace(record.find(" " + born + " "), born.size() + 2, " 1 ");
    fs::remove(dir.file(keepName()));
    TempDir::writeTo(dir.file(keepName()), record);
    ::chmod(dir.file(keepName()).c_str(), 0600);
    EXPECT_EQ(restoreFinding(), KeepFinding::State::Orphan);
    EXPECT_EQ(ReadBytes(path), New.substr(0, 5) + Old.substr(5));
    ReplaceOptions options;
    options.home = home.path().string();
    ReplacePart(part, {New}, options);
    EXPECT_EQ(ReadBytes(path), New);
    EXPECT_EQ(ReadBytes(dir.file(keepName())), record) << "the copy stays for its owner to look at";
}

// In a setgid folder a file that another user makes takes the part's group. His forged copy, as
// anyone can write one, is never written into the part, however well it names it; the part stays
// as it is, and saves go on.
TEST_F(InterruptedSave, AnotherUsersCopyIsNeverApplied)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to give a copy another owner";
    ASSERT_EQ(::chmod(dir.path().c_str(), 02775), 0);
    ASSERT_EQ(::chmod(path.c_str(), 0664), 0);
    interruptedWith(New.substr(0, 5) + Old.substr(5));
    const auto copy = dir.file(keepName());
    ASSERT_EQ(::chown(copy.c_str(), 12345, StatOf(path).st_gid), 0);
    const auto finding = ExamineKeepFile(*part, home.path().string());
    EXPECT_EQ(finding.state, KeepFinding::State::OthersCopy);
    EXPECT_EQ(OthersCopyNotice(path, finding),
              path + ": a copy left by another user's interrupted save is at " + copy +
                  "; it was not applied; the file stays as that save left it until that user saves it again");
    EXPECT_EQ(restoreFinding(), KeepFinding::State::OthersCopy);
    EXPECT_EQ(ReadBytes(path), New.substr(0, 5) + Old.substr(5));
    // His copy, even one nobody else may write, is still his; and one of this user's that others
    // may write could be anyone's.
    ASSERT_EQ(::chmod(copy.c_str(), 0600), 0);
    EXPECT_EQ(restoreFinding(), KeepFinding::State::OthersCopy);
    ASSERT_EQ(::chown(copy.c_str(), 0, StatOf(path).st_gid), 0);
    ASSERT_EQ(::chmod(copy.c_str(), 0660), 0);
    EXPECT_EQ(restoreFinding(), KeepFinding::State::OthersCopy);
    ReplaceOptions options;
    options.home = home.path().string();
    ReplacePart(part, {New}, options);
    EXPECT_EQ(ReadBytes(path), New);
    EXPECT_TRUE(fs::exists(copy));
}

TEST_F(InterruptedSave, ACopyWhoseWriterStillHoldsItIsLeftAlone)
{
    interruptedWith(New.substr(0, 5) + Old.substr(5));
    const FileDescriptor writer(::open(dir.file(keepName()).c_str(), O_RDONLY));
    ASSERT_EQ(::flock(writer.get(), LOCK_EX), 0);
    EXPECT_THROW(restore(), FileLockedError);
    EXPECT_EQ(ReadBytes(path), New.substr(0, 5) + Old.substr(5));
    EXPECT_TRUE(fs::exists(dir.file(keepName())));
}

// Another user who may write the folder swaps the part for a link to a file of the victim's
// while the part is open: the restore writes the file it opened, never the link's target.
TEST_F(InterruptedSave, ALinkPutInThePartsPlaceLeadsNowhere)
{
    interruptedWith(New.substr(0, 5) + Old.substr(5));
    const auto victim = home.write("private.txt", "the victim's own bytes");
    fs::rename(path, dir.file("moved.dat"));
    fs::create_symlink(victim, path);
    EXPECT_TRUE(restore());
    EXPECT_EQ(ReadBytes(victim), "the victim's own bytes");
    EXPECT_EQ(ReadBytes(dir.file("moved.dat")), Old);
}

// Marks a folder so that nobody, not even root, may create files in it; false where the file
// system cannot.
bool makeImmutable(const fs::path& folder, bool immutable)
{
    const FileDescriptor fd(::open(folder.c_str(), O_RDONLY | O_DIRECTORY));
    int flags = 0;
    if (::ioctl(fd.get(), FS_IOC_GETFLAGS, &flags) != 0)
        return false;
    flags = immutable ? flags | FS_IMMUTABLE_FL : flags & ~FS_IMMUTABLE_FL;
    return ::ioctl(fd.get(), FS_IOC_SETFLAGS, &flags) == 0;
}

// Where the user may not create files beside the part, the copy goes to a folder of his own below
// his home, which nobody else may enter; the next save finds it there.
TEST_F(InterruptedSave, TheCopyOfAPartInAFolderOfOthersStaysInAFolderOfTheUsersOwn)
{
    if (!makeImmutable(dir.path(), true))
        GTEST_SKIP() << "this file system cannot keep a folder from new files";
    interruptedWith(New.substr(0, 5) + Old.substr(5));
    const auto own = home.path() / ".local/state/Quillmark/keep";
    EXPECT_TRUE(fs::exists(own / keepName()));
    EXPECT_EQ(fs::status(own).permissions(), fs::perms::owner_all);
    EXPECT_TRUE(restore());
    makeImmutable(dir.path(), false);
    EXPECT_EQ(ReadBytes(path), Old);
    EXPECT_FALSE(fs::exists(own / keepName()));
}

} // namespace
