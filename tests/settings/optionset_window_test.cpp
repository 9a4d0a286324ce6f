#include "SettingsFixture.h"

#include "support/Files.h"
#include "support/SampleOptions.h"

#include "emulator/OptionFile.h"

#include <QImageReader>
#include <QtEndian>

namespace {

// The Save and Load buttons and the load of a damaged set, as the window shows them. (Every
// shape of a set on disk is read by the option set's own tests.)
class OptionSetButtons : public SettingsFixture {
protected:
    void save(frmSettings& w, const QString& chosen) {
        fake.dialogs.paths.push_back(chosen);
        w.cmdSaveDat_Click();
    }
    QString status(const frmSettings& w) { return control<QLabel>(w, "lblConfig")->text(); }
};

} // namespace

TEST_F(OptionSetButtons, AskForAFileReportAddTheExtensionAndNeverLoseAFile) {
    auto w = open();
    w->showConfigStatus("before", "tip");
    // The choosers open in the user's folder, made if missing, where Default.lum starts lum.
    QDir(fake.platform.userFolder).removeRecursively();
    w->cmdSaveDat_Click(); // cancelled
    w->cmdLoadDat_Click(); // cancelled
    EXPECT_EQ(status(*w), "before");
    EXPECT_EQ(control<QLabel>(*w, "lblConfig")->toolTip(), "tip");
    const std::string chooser = " | Choose File to Save Configuration | lum configurations "
                                "(*.lum)|*.lum|All Files (*.*)|*.* | " +
                                fake.platform.userFolder.toStdString() + " | 1 | ";
    EXPECT_EQ(requestLines(fake.dialogs),
              (Lines{"save" + chooser + "2", "open" + chooser + "1800"}));
    EXPECT_TRUE(QFileInfo(fake.platform.userFolder).isDir());
    EXPECT_EQ(control<QLabel>(*w, "lblConfig")->textFormat(), Qt::PlainText); // names as typed

    // The name as chosen in the status line, the file with ".lum" added.
    control<QRadioButton>(*w, "optCPPAL")->click();
    save(*w, fake.root() + "/name");
    EXPECT_EQ(fileBytes(fake.root() + "/name.lum"), encodeOptions(w->options()));
    EXPECT_EQ(status(*w), "name was succesfully saved");
    EXPECT_EQ(control<QLabel>(*w, "lblConfig")->toolTip(), "");

    auto other = open();
    fake.dialogs.paths = {fake.root() + "/name.lum"};
    other->cmdLoadDat_Click();
    EXPECT_EQ(status(*other), "name.lum was succesfully loaded");
    EXPECT_EQ(other->options().palette, Palette::Pal);
    EXPECT_TRUE(control<QRadioButton>(*other, "optCPPAL")->isChecked());
    EXPECT_TRUE(fake.dialogs.boxes.empty());
    EXPECT_FALSE(other->isHidden()); // a good load leaves the window as it was

    // Saving never loses a file.
    save(*w, fake.root() + "/no such folder/set");
    EXPECT_EQ(status(*w), "error saving set");
    // From the main menu a box names the file and why.
    fake.dialogs.paths = {fake.root() + "/no such folder/set"};
    w->saveOptionSetFromMenu();
    EXPECT_EQ(boxLines(fake.dialogs),
              Lines{"lum | " + fake.root().toStdString() +
                    "/no such folder/set.lum could not be saved:\nNo such file or directory | Ok | "
                    "Exclamation"});
    fake.dialogs.boxes.clear();

    const QString older = fake.root() + "/older.lum";
    ASSERT_TRUE(putFile(older, QByteArray(172, '\x11')));

    // A name the extension was added to does not replace a file unasked.
    w->showConfigStatus("before", {});
    fake.dialogs.answers = {MsgResult::No, MsgResult::Yes};
    save(*w, fake.root() + "/older");
    EXPECT_EQ(fileBytes(older), QByteArray(172, '\x11'));
    EXPECT_EQ(status(*w), "before");
    save(*w, fake.root() + "/older");
    EXPECT_EQ(fileBytes(older), encodeOptions(w->options()));
    EXPECT_EQ(status(*w), "older was succesfully saved");
    EXPECT_EQ(boxLines(fake.dialogs),
              Lines(2, "Choose File to Save Configuration | older.lum already exists.\r\nDo you "
                       "want to replace it? | YesNo | Exclamation"));
    // A name chosen with its extension was asked about by the chooser itself.
    save(*w, older);
    EXPECT_EQ(fake.dialogs.boxes.size(), 2u);
}

TEST_F(OptionSetButtons, ACorruptSetIsReportedWithWhatCameBeforeTheBadValueShown) {
    QByteArray bytes = encodeOptions(EmulatorOptions());
    qToLittleEndian<qint16>(3, bytes.data());      // video mode 3
    qToLittleEndian<qint16>(3, bytes.data() + 14); // "Player 0 hard": no such state
    qToLittleEndian<qint16>(1, bytes.data() + 16); // "Player 1 hard", after it
    ASSERT_TRUE(putFile(fake.root() + "/bad.lum", bytes));

    auto w = std::make_unique<frmSettings>(fake.platform); // hidden, as at start-up
    w->selectPage("Video");
    fake.dialogs.paths = {fake.root() + "/bad.lum"};
    w->cmdLoadDat_Click();
    EXPECT_EQ(status(*w),
              "bad.lum is corrupt.  Plese verify settings an re-save to correct the problem");
    EXPECT_EQ(boxLines(fake.dialogs), Lines{"lum | .lum file is corrupt\r\nPlease verify settings "
                                            "and re-save to correct this problem | Ok | None"});
    EXPECT_EQ(control<QComboBox>(*w, "comboVideoMode")->currentIndex(), 3);
    EXPECT_EQ(w->options().player1Hard, Check::Off);
    EXPECT_TRUE(w->isVisible());
    EXPECT_EQ(w->selectedPage(), "Settings");

    // From the main menu the box names the file and why; one that cannot be read applies
    // nothing.
    fake.dialogs.paths = {fake.root() + "/missing.lum"};
    w->loadOptionSetFromMenu();
    EXPECT_EQ(
        boxLine(fake.dialogs.boxes.back()),
        "lum | " + fake.root().toStdString() +
            "/missing.lum could not be loaded:\nNo such file or directory | Ok | Exclamation");
    EXPECT_EQ(w->options().videoMode, 3);
    EXPECT_EQ(status(*w),
              "missing.lum is corrupt.  Plese verify settings an re-save to correct the problem");
}

// data/Default.lum is the option set of the settings window as it starts, written by the
// window's own save. When the start state or the file's layout changes, its test fails;
// run it once with LUM_UPDATE_DEFAULT_LUM=1 to write the new file, then commit it.
TEST_F(OptionSetButtons, DefaultLumIsTheStartStateOfTheWindow) {
    frmSettings w(fake.platform);
    save(w, fake.root() + "/start.lum");
    const QByteArray produced = fileBytes(fake.root() + "/start.lum");
    const QString committed = sourcePath("data/Default.lum");
    if (!qgetenv("LUM_UPDATE_DEFAULT_LUM").isEmpty()) {
        ASSERT_TRUE(putFile(committed, produced));
    }
    EXPECT_EQ(fileBytes(committed).toHex(' '), produced.toHex(' '))
        << "data/Default.lum is out of date: run this test with LUM_UPDATE_DEFAULT_LUM=1";

    // And it loads back every option as the window starts.
    w.setOptions(sampleOptions());
    ASSERT_TRUE(w.LoadSettings(committed));
    EmulatorOptions start;
    start.customFrameRate = "0"; // a set keeps numbers, so the empty rate comes back as 0
    EXPECT_EQ(w.options(), start);
    EXPECT_TRUE(fake.dialogs.boxes.empty());
}

TEST_F(OptionSetButtons, ControllerPicturesLieBesideDefaultLumUnderTheNamesTheButtonsUse) {
    for (const char* caption : {"Standard Control Layout", "Paddle Control Layout",
                                "Keyboard Control Layout", "Driving Control Layout"}) {
        QImageReader reader(sourcePath("data") + frmSettings::GetPicName(caption));
        EXPECT_TRUE(reader.canRead()) << caption;
        EXPECT_EQ(reader.format(), "jpeg") << caption;
    }
}
