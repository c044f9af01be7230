#include "app/Resources.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::ReadFile;
using testing::TempFolder;
using testing::WriteFile;

TEST(Resources, MissingFilesAreCopiedWithTheirFoldersAndTheUsersFilesStay) {
  TempFolder resources;
  fs::create_directories(resources.path() / "Icons");
  fs::create_directories(resources.path() / "Samples" / "deep");
  WriteFile(resources.File("Icons/0.png"), "red dot");
  WriteFile(resources.File("Icons/Custom.png"), "our marker");
  WriteFile(resources.File("SpeedLegend.jpg"), "legend");
  WriteFile(resources.File("Samples/deep/a.plt"), "sample");

  TempFolder program;
  fs::create_directories(program.path() / "Icons");
  WriteFile(program.File("Icons/Custom.png"), "the user's own icon");

  InstallResources(program.path().string(), resources.path().string());
  EXPECT_EQ(ReadFile(program.File("Icons/0.png")), "red dot");
  EXPECT_EQ(ReadFile(program.File("Icons/Custom.png")), "the user's own icon");
  EXPECT_EQ(ReadFile(program.File("SpeedLegend.jpg")), "legend");
  EXPECT_EQ(ReadFile(program.File("Samples/deep/a.plt")), "sample");
  EXPECT_FALSE(fs::exists(program.File("Icons/0.png.part")));

  // An edited legend survives the next start; a deleted icon comes back.
  WriteFile(program.File("SpeedLegend.jpg"), "edited");
  fs::remove(program.File("Icons/0.png"));
  InstallResources(program.path().string(), resources.path().string());
  EXPECT_EQ(ReadFile(program.File("SpeedLegend.jpg")), "edited");
  EXPECT_EQ(ReadFile(program.File("Icons/0.png")), "red dot");
}

TEST(Resources, HelpPagesFollowTheProgram) {
  TempFolder resources;
  fs::create_directories(resources.path() / "Help");
  WriteFile(resources.File("Help/MolvarHelp.html"), "new guide");
  TempFolder program;
  fs::create_directories(program.path() / "Help");
  WriteFile(program.File("Help/MolvarHelp.html"), "old guide");
  InstallResources(program.path().string(), resources.path().string());
  EXPECT_EQ(ReadFile(program.File("Help/MolvarHelp.html")), "new guide");
  EXPECT_FALSE(fs::exists(program.File("Help/MolvarHelp.html.part")));
}

TEST(Resources, MissingSourceOrUnwritableTargetChangesNothing) {
  TempFolder program;
  InstallResources(program.path().string(), program.File("no-such-folder"));
  EXPECT_TRUE(fs::is_empty(program.path()));

  TempFolder resources;
  WriteFile(resources.File("SpeedLegend.jpg"), "legend");
  // A plain file where the program folder should be: nothing can be copied, nothing throws.
  WriteFile(program.File("blocked"), "x");
  EXPECT_NO_THROW(InstallResources(program.File("blocked"), resources.path().string()));
  EXPECT_EQ(ReadFile(program.File("blocked")), "x");
  // The same folder as source and target is left as it is.
  EXPECT_NO_THROW(InstallResources(resources.path().string(), resources.path().string()));
  EXPECT_EQ(ReadFile(resources.File("SpeedLegend.jpg")), "legend");
}

TEST(Resources, TheInstalledResourcesHoldEveryFileTheWritersReferTo) {
  TempFolder program;
  InstallResources(program.path().string());
  std::vector<std::string> names{"SpeedLegend.jpg", "Icons/Custom.png", "Icons/Custom.jpg"};
  for (int k = 0; k <= 9; ++k) names.push_back("Icons/" + std::to_string(k) + ".png");
  for (int k = 2; k <= 5; ++k) names.push_back("Icons/palette-" + std::to_string(k) + ".jpg");
  for (const auto& name : names) {
    ASSERT_TRUE(fs::is_regular_file(program.File(name))) << name;
    EXPECT_EQ(ReadFile(program.File(name)), ReadFile(std::string(MOLVAR_RESOURCE_DIR) + "/" + name)) << name;
  }
  // PNG and JPEG signatures: the files are images, not placeholders.
  EXPECT_EQ(ReadFile(program.File("Icons/3.png")).substr(0, 8), "\x89PNG\r\n\x1a\n");
  EXPECT_EQ(ReadFile(program.File("SpeedLegend.jpg")).substr(0, 3), "\xFF\xD8\xFF");
  EXPECT_TRUE(fs::is_regular_file(program.File("Samples/sample.plt")));
}

// The dot icons are the track colours: the centre pixel of icon k is palette entry k (kept in
// blue-green-red order), the corners are transparent.
TEST(Resources, DotIconsShowThePaletteColours) {
  testing::TestProgram t;
  for (int k = 0; k <= 9; ++k) {
    const std::string icon = std::string(MOLVAR_RESOURCE_DIR) + "/Icons/" + std::to_string(k) + ".png";
    int rc = -1;
    const std::string seen = testing::RunCommand(
        "/usr/bin/python3 -c \"from PIL import Image; i = Image.open('" + icon +
            "').convert('RGBA'); r, g, b, a = i.getpixel((16, 16)); print(i.size, '%02X%02X%02X' % (b, g, r), a, "
            "i.getpixel((0, 0))[3], i.getpixel((31, 31))[3])\" 2>&1",
        &rc);
    ASSERT_EQ(rc, 0) << seen;
    EXPECT_EQ(seen, "(32, 32) " + t->ColorTable[static_cast<std::size_t>(k)] + " 255 0 0\n") << icon;
  }
}

}  // namespace
}  // namespace molvar
