#include "platform/win/detail/DriveTable.h"

#include <gtest/gtest.h>

using tvx::win::Drive;
using tvx::win::DriveKind;
using tvx::win::DriveTable;

namespace {

DriveTable fromMounts(std::string_view mounts) {
    return DriveTable::fromMounts(mounts, [](std::string_view device) { return device == "/dev/sdb1"; });
}

DriveTable fromText(std::string_view text, std::size_t mistakes = 0) {
    std::vector<std::string> found;
    DriveTable table = DriveTable::fromText(text, found);
    EXPECT_EQ(found.size(), mistakes) << text;
    return table;
}

/// "C:/ D:/media/disc ..." with the kinds and shares.
std::string describe(const DriveTable& table) {
    std::string text;
    for (const Drive& drive : table.drives()) {
        text += text.empty() ? "" : " ";
        text += drive.letter ? std::string(1, drive.letter) + ":" : std::string("-");
        text += drive.folder;
        text += drive.kind == DriveKind::Removable ? "(removable)" : drive.kind == DriveKind::Optical ? "(disc)" : "";
        text += drive.remoteName.empty() ? "" : "(" + drive.remoteName + ")";
    }
    return text;
}

/// The name of the share that a source is connected as.
std::string shareOf(const std::string& fileSystem, const std::string& source) {
    const DriveTable table = fromMounts("40 26 0:50 / /mnt/point rw - " + fileSystem + " " + source + " rw\n");
    return table.drives().size() == 2 ? table.drives()[1].remoteName : "";
}

} // namespace

TEST(DriveTable, MountsGetLettersInTheirOrder) {
    EXPECT_EQ(describe(fromMounts("")), "C:/");
    EXPECT_EQ(describe(fromMounts("26 1 254:0 / / rw,relatime - ext4 /dev/vda rw\n"
                                  "22 26 0:20 / /proc rw - proc proc rw\n"
                                  "41 26 8:17 / /mnt/stick rw shared:3 master:1 - vfat /dev/sdb1 rw\n"
                                  "42 26 0:51 / /mnt/plans rw - nfs4 files:/srv/plans rw,vers=4.2\n"
                                  "43 26 11:0 / /media/disc ro - iso9660 /dev/sr0 ro\n"
                                  "44 26 8:33 / /run/media/me/My\\040Disk rw shared:9 - ext4 /dev/sdc1 rw\n"
                                  "45 26 8:2 / /home rw - ext4 /dev/sda2 rw\n"
                                  "46 26 0:60 / /run/user/1000/gvfs rw - fuse.gvfsd-fuse gvfsd-fuse rw")),
              "C:/ D:/media/disc(disc) E:/mnt/plans(\\\\files\\plans) F:/mnt/stick(removable) "
              "G:/run/media/me/My Disk(removable)");
}

TEST(DriveTable, OnlyTheTopOfSeveralMountsOnAPointCounts) {
    EXPECT_EQ(describe(fromMounts("40 26 0:50 / /mnt rw - nfs a:/x rw\n41 40 0:51 / /mnt rw - tmpfs tmpfs rw\n")),
              "C:/");
    EXPECT_EQ(describe(fromMounts("1 1 0:9 / / rw - nfs server:/root rw\n")), "C:/") << "the root is the fixed drive";
}

TEST(DriveTable, SharesAreNamedAfterServerAndFolder) {
    EXPECT_EQ(shareOf("nfs", "files:/srv/data"), "\\\\files\\data");
    EXPECT_EQ(shareOf("nfs4", "[fe80::1]:/data/"), "\\\\fe80--1\\data");
    EXPECT_EQ(shareOf("nfs4", "files:/"), "\\\\files\\point");
    EXPECT_EQ(shareOf("cifs", "//Files/Team\\040Data"), "\\\\Files\\Team Data");
    EXPECT_EQ(shareOf("smb3", "//files/share/deep/folder"), "\\\\files\\share-deep-folder");
    EXPECT_EQ(shareOf("fuse.sshfs", "me@files:"), "\\\\files\\point");
    EXPECT_EQ(shareOf("fuse.sshfs", "me@files:work"), "\\\\files\\work");
    EXPECT_EQ(shareOf("fuse.davfs", "https://cloud.example/dav/me"), "\\\\cloud.example\\me");
    EXPECT_EQ(shareOf("fuse.sshfs", "me@files:a/odd:/work"), "\\\\files-a-odd\\work");
    EXPECT_EQ(shareOf("ceph", "10.0.0.1:6789,10.0.0.2:6789:/vol"), "\\\\10.0.0.1-6789\\vol");
    for (const char* source : {"nothing", ":/x", "//", "@:/x"}) {
        EXPECT_EQ(shareOf("nfs", source), "") << source;
    }
}

TEST(DriveTable, SharesOfOneServerHaveDifferentNames) {
    EXPECT_EQ(describe(fromMounts("1 1 0:9 / /a rw - nfs s:/x/data rw\n2 1 0:9 / /b rw - nfs s:/y/data rw\n")),
              "C:/ D:/a(\\\\s\\data) E:/b(\\\\s\\y-data)");
}

TEST(DriveTable, SharesWithoutALetterAreStillConnected) {
    std::string mounts;
    for (int i = 100; i < 130; ++i) {
        mounts += "1 1 0:9 / /mnt/" + std::to_string(i) + " rw - nfs s:/" + std::to_string(i) + " rw\n";
    }
    const DriveTable table = fromMounts(mounts);
    EXPECT_EQ(table.find('Z')->folder, "/mnt/122");
    ASSERT_NE(table.findShare("\\\\S\\129"), nullptr);
    EXPECT_EQ(table.findShare("\\\\S\\129")->letter, 0);
    EXPECT_EQ(table.holding("/mnt/129/x")->letter, 'C');
    EXPECT_EQ(table.find('\0'), nullptr);
}

TEST(DriveTable, LinesThatMakeNoSenseArePassedOver) {
    EXPECT_EQ(describe(fromMounts("\n - \nx\n1 2 3 4 relative rw - nfs s:/x rw\n1 2 3 4 /nul\\000 rw - nfs s:/x rw\n"
                                  "40 26 0:50 / /bad\\99\\1 rw - nfs s:/x\n41 26 0:50 / /m - nfs")),
              "C:/ D:/bad\\99\\1(\\\\s\\x)");
}

TEST(DriveTable, ATextReplacesTheTable) {
    const DriveTable table =
        fromText("c=/;D=/srv/work/;E=/stick|removable;F=/disc|cdrom;X=/data|\\\\Srv\\Data;;G=/g|fixed");
    EXPECT_EQ(describe(table), "C:/ D:/srv/work E:/stick(removable) F:/disc(disc) G:/g X:/data(\\\\Srv\\Data)");
    EXPECT_EQ(table.find('d'), table.find('D'));
    EXPECT_EQ(table.findShare("\\\\srv\\DATA"), table.find('X'));
    EXPECT_EQ(table.holding("/srv/work"), table.find('D'));
    EXPECT_EQ(table.holding("/srv/work/a"), table.find('D'));
    EXPECT_EQ(table.holding("/srv/worker"), table.find('C'));
    EXPECT_EQ(fromText("D=/srv").holding("/home"), nullptr);
}

TEST(DriveTable, MistakesInTheTextAreLeftOutAndTold) {
    EXPECT_EQ(describe(fromText("C=/;CC=/x;D;=/y;1=/z;E=relative;F=/f|floppy;G=/g|\\\\server;C=/again", 8)), "C:/");
    EXPECT_EQ(describe(fromText("C=/;D=/d|\\\\s\\;E=/d|\\\\\\d;F=/d|\\\\s\\d\\;G=/d|\\\\s\\d\\x;H=/d|\\\\s/d\\x", 5)),
              "C:/")
        << "names below such shares would not be found again";
    EXPECT_EQ(describe(fromText("")), "");
}
