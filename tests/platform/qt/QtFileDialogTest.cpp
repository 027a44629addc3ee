#include "platform/qt/QtFileDialog.h"

#include <gtest/gtest.h>

#include <QDialogButtonBox>
#include <QDir>
#include <QFile>
#include <QFileDialog>
#include <QLineEdit>
#include <QListView>
#include <QPushButton>
#include <QTemporaryDir>
#include <QTest>
#include <QThread>
#include <QTimer>

#include "tests/support/WhileModal.h"

namespace {

constexpr const char* GameFilter = "XML Files & (*.xml) |*.xml";

TEST(NameFilters, AreMadeOfDescriptionAndPatterns) {
  const auto filters = [](const char* text) {
    return NameFilters(text).join(QLatin1Char('|')).toStdString();
  };
  EXPECT_EQ(filters(GameFilter), "XML Files & (*.xml)");
  EXPECT_EQ(filters("Text documents (*.txt) |*.txt"), "Text documents (*.txt)");
  EXPECT_EQ(filters("Playlist Files|*.txt|All Files|*.*"), "Playlist Files (*.txt)|All Files (*)");
  EXPECT_EQ(filters("Photo Files(*.bmp,*.jpg,*.gif)|*.bmp;*.jpg;*.gif"), "Photo Files (*.bmp *.jpg *.gif)");
  EXPECT_EQ(filters("Wave Files|*.wav;|PCM Files|*.pcm;"), "Wave Files (*.wav)|PCM Files (*.pcm)");
  EXPECT_EQ(filters("A Files (*.A;*.B)|*.A;*.B| All Files (*.*)|*.*"), "A Files (*.A *.B)|All Files (*)");
  EXPECT_EQ(filters(""), "");
}

class QtFileDialogTest : public testing::Test {
 protected:
  using Act = std::function<void(QFileDialog&)>;

  std::optional<std::string> Open(const std::string& name, const Act& act,
                                  const std::string& filter = GameFilter) {
    return Open({.Filter = filter, .Name = name}, act);
  }

  std::optional<std::string> Open(const FileRequest& request, const Act& act) {
    const WhileModal<QFileDialog> operatorAtWork(act);
    std::optional<std::string> result = Dialog.ShowOpen(request);
    EXPECT_EQ(operatorAtWork.Runs(), 1);
    return result;
  }

  std::optional<std::string> Save(const std::string& name, const Act& act,
                                  const std::string& filter = GameFilter) {
    return Save({.Filter = filter, .Name = name}, act);
  }

  std::optional<std::string> Save(const FileRequest& request, const Act& act) {
    const WhileModal<QFileDialog> operatorAtWork(act);
    std::optional<std::string> result = Dialog.ShowSave(request);
    EXPECT_EQ(operatorAtWork.Runs(), 1);
    return result;
  }

  std::string Path(const std::string& name) const {
    return folder_.filePath(QString::fromStdString(name)).toStdString();
  }

  void MakeFile(const std::string& name) const {
    QFile file(QString::fromStdString(Path(name)));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
  }

  static QLineEdit& Entry(QFileDialog& dialog) {
    return *dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
  }

  static void Press(QFileDialog& dialog, QDialogButtonBox::StandardButton button) {
    QTest::mouseClick(dialog.findChild<QDialogButtonBox*>()->button(button), Qt::LeftButton);
  }

  static Act Enter(const std::string& name, QDialogButtonBox::StandardButton button) {
    return [name, button](QFileDialog& dialog) {
      Entry(dialog).setText(QString::fromStdString(name));
      Press(dialog, button);
    };
  }

  QtFileDialog Dialog{[] { return QApplication::activeModalWidget(); }};

 private:
  QTemporaryDir folder_;
};

TEST_F(QtFileDialogTest, OpensTheFileChosen) {
  MakeFile("得分 一.xml");
  EXPECT_EQ(Open("",
                 [&](QFileDialog& dialog) {
                   EXPECT_EQ(dialog.objectName(), QStringLiteral("CommonDialog1"));
                   EXPECT_EQ(dialog.acceptMode(), QFileDialog::AcceptOpen);
                   EXPECT_EQ(dialog.nameFilters(), QStringList{QStringLiteral("XML Files & (*.xml)")});
                   Enter(Path("得分 一.xml"), QDialogButtonBox::Open)(dialog);
                 }),
            Path("得分 一.xml"));
}

TEST_F(QtFileDialogTest, OpensANameWithoutAFileForTheCallerToJudge) {
  EXPECT_EQ(Open("", Enter(Path("missing.xml"), QDialogButtonBox::Open)), Path("missing.xml"));
}

TEST_F(QtFileDialogTest, SavesUnderTheNameEntered) {
  EXPECT_EQ(Save("",
                 [&](QFileDialog& dialog) {
                   EXPECT_EQ(dialog.objectName(), QStringLiteral("CommonDialog1"));
                   EXPECT_EQ(dialog.acceptMode(), QFileDialog::AcceptSave);
                   EXPECT_EQ(dialog.nameFilters(), QStringList{QStringLiteral("XML Files & (*.xml)")});
                   Enter(Path("星期六.xml"), QDialogButtonBox::Save)(dialog);
                 }),
            Path("星期六.xml"));
}

TEST_F(QtFileDialogTest, TakesTheKeysThatWereTypedBeforeAScreenReaderPressesItsButton) {
  EXPECT_EQ(Save(Path("last.xml"),
                 [](QFileDialog& dialog) {
                   Entry(dialog).selectAll();
                   // Both are due when the events are served next, the keys as the first.
                   QTimer::singleShot(50, Qt::PreciseTimer, &dialog, [&dialog] {
                     for (const QChar key : QStringLiteral("new.xml")) {
                       for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
                         qt_handleKeyEvent(dialog.windowHandle(), type, key.toUpper().unicode(), {}, key);
                       }
                     }
                   });
                   dialog.findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Save)->animateClick();
                   QThread::msleep(200);
                 }),
            Path("new.xml"));
}

TEST_F(QtFileDialogTest, TakesTheNameThatStandsThereInPlaceOfTheFileSelected) {
  MakeFile("last.xml");
  const auto name = [](const char* text) {
    return [text](QFileDialog& dialog) {
      // As long as the window is not in front, its entry has no focus.
      Entry(dialog).clearFocus();
      Enter(text, QDialogButtonBox::Save)(dialog);
    };
  };
  EXPECT_EQ(Save(Path("last.xml"), name("new.xml")), Path("new.xml"));
  EXPECT_EQ(Save(Path("last.xml"), name("last.xml")), Path("last.xml"));
}

TEST_F(QtFileDialogTest, OpensTheFolderThatIsSelected) {
  MakeFile("last.xml");
  ASSERT_TRUE(QDir(QString::fromStdString(Path(""))).mkdir(QStringLiteral("more")));
  EXPECT_EQ(Save(Path("last.xml"),
                 [](QFileDialog& dialog) {
                   auto* list = dialog.findChild<QListView*>(QStringLiteral("listView"));
                   QModelIndex folder;
                   ASSERT_TRUE(QTest::qWaitFor([&] {
                     const auto* model = list->model();
                     const auto found = model->match(model->index(0, 0, list->rootIndex()), Qt::DisplayRole,
                                                     QStringLiteral("more"));
                     folder = found.isEmpty() ? QModelIndex() : found.first();
                     return folder.isValid();
                   }));
                   list->setFocus();
                   list->selectionModel()->select(
                       folder, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
                   Press(dialog, QDialogButtonBox::Save);
                   EXPECT_TRUE(dialog.isVisible());
                   EXPECT_EQ(dialog.directory().dirName(), QStringLiteral("more"));
                   Enter("deep.xml", QDialogButtonBox::Save)(dialog);
                 }),
            Path("more/deep.xml"));
}

TEST_F(QtFileDialogTest, SavesOverAnExistingFileWithoutAQuestion) {
  MakeFile("old.xml");
  EXPECT_EQ(Save("", Enter(Path("old.xml"), QDialogButtonBox::Save)), Path("old.xml"));
}

TEST_F(QtFileDialogTest, ANameSavedWithoutASuffixGetsThatOfTheFilter) {
  EXPECT_EQ(Save("", Enter(Path("game"), QDialogButtonBox::Save)), Path("game.xml"));
  EXPECT_EQ(Save("", Enter(Path("game.old"), QDialogButtonBox::Save)), Path("game.old"));
  EXPECT_EQ(Save("", Enter(Path("list"), QDialogButtonBox::Save), "All Files|*.*"), Path("list"));
}

TEST_F(QtFileDialogTest, TheSuffixFollowsTheFilterThatIsPicked) {
  const std::string filter = "Wave Files|*.wav;|Raw Files|*.raw;";
  EXPECT_EQ(Save(
                "",
                [&](QFileDialog& dialog) {
                  dialog.selectNameFilter(QStringLiteral("Raw Files (*.raw)"));
                  emit dialog.filterSelected(QStringLiteral("Raw Files (*.raw)"));
                  Enter(Path("shot"), QDialogButtonBox::Save)(dialog);
                },
                filter),
            Path("shot.raw"));
}

TEST_F(QtFileDialogTest, CancelGivesNoName) {
  MakeFile("last.xml");
  const auto cancel = [](QFileDialog& dialog) { Press(dialog, QDialogButtonBox::Cancel); };
  const auto escape = [](QFileDialog& dialog) { QTest::keyClick(&dialog, Qt::Key_Escape); };
  const auto close = [](QFileDialog& dialog) { dialog.close(); };
  for (const auto& act : std::vector<Act>{cancel, escape, close}) {
    EXPECT_EQ(Open("", act), std::nullopt);
    EXPECT_EQ(Save("", act), std::nullopt);
    EXPECT_EQ(Save(Path("last.xml"), act), std::nullopt);
    EXPECT_EQ(Save("bare name", act), std::nullopt);
  }
}

TEST_F(QtFileDialogTest, StartsWithTheNameHandedIn) {
  MakeFile("last.xml");
  const auto look = [&](QFileDialog& dialog) {
    EXPECT_EQ(dialog.directory().filePath(QStringLiteral("last.xml")).toStdString(), Path("last.xml"));
    EXPECT_EQ(Entry(dialog).text(), QStringLiteral("last.xml"));
    dialog.reject();
  };
  Open(Path("last.xml"), look);
  Save(Path("last.xml"), look);
}

TEST_F(QtFileDialogTest, StartsInTheFolderLastChosenFrom) {
  MakeFile("one.xml");
  Open("", Enter(Path("one.xml"), QDialogButtonBox::Open));
  Open("", [&](QFileDialog& dialog) {
    EXPECT_EQ(dialog.directory().filePath(QStringLiteral("one.xml")).toStdString(), Path("one.xml"));
    EXPECT_EQ(Entry(dialog).text(), QString());
    dialog.reject();
  });
}

TEST_F(QtFileDialogTest, StartsInTheFolderAskedFor) {
  MakeFile("last.xml");
  const QTemporaryDir other;
  const auto look = [&](QFileDialog& dialog) {
    EXPECT_EQ(dialog.directory().absolutePath(), other.path());
    EXPECT_EQ(Entry(dialog).text(), QStringLiteral("last.xml"));
    dialog.reject();
  };
  const std::string folder = other.path().toStdString();
  Open(FileRequest{.Filter = GameFilter, .Name = Path("last.xml"), .Folder = folder}, look);
  Save(FileRequest{.Filter = GameFilter, .Name = "last.xml", .Folder = folder}, look);
}

TEST_F(QtFileDialogTest, PassesOverAFolderThatDoesNotExist) {
  MakeFile("last.xml");
  Open(FileRequest{.Filter = GameFilter, .Name = Path("last.xml"), .Folder = Path("none")},
       [&](QFileDialog& dialog) {
         EXPECT_EQ(dialog.directory().filePath(QStringLiteral("last.xml")).toStdString(), Path("last.xml"));
         dialog.reject();
       });
}

TEST_F(QtFileDialogTest, ShowsTheTitleAskedForInADialogOfTheToolkit) {
  const auto look = [](QFileDialog& dialog) {
    EXPECT_EQ(dialog.windowTitle(), QStringLiteral("Open 得分"));
    EXPECT_TRUE(dialog.testOption(QFileDialog::DontUseNativeDialog));
    dialog.reject();
  };
  Open(FileRequest{.Filter = GameFilter, .Title = "Open 得分"}, look);
  Save(FileRequest{.Filter = GameFilter, .Title = "Open 得分"}, look);
  Open("", [](QFileDialog& dialog) {
    EXPECT_NE(dialog.windowTitle(), QString());
    dialog.reject();
  });
}

TEST_F(QtFileDialogTest, GivesNoNameWhenItsWindowIsDestroyed) {
  auto* window = new QDialog;
  window->setModal(true);
  window->show();
  EXPECT_EQ(Open("name.xml",
                 [&](QFileDialog& dialog) {
                   EXPECT_EQ(dialog.parentWidget(), window);
                   delete window;
                 }),
            std::nullopt);
}

TEST_F(QtFileDialogTest, GivesTheFolderChosen) {
  const QTemporaryDir above;
  ASSERT_TRUE(QDir(above.path()).mkdir(QStringLiteral("games")));
  const WhileModal<QFileDialog> operatorAtWork([&](QFileDialog& dialog) {
    EXPECT_EQ(dialog.windowTitle(), QStringLiteral("Games"));
    EXPECT_EQ(dialog.directory().absolutePath(), above.path());
    EXPECT_TRUE(dialog.testOption(QFileDialog::ShowDirsOnly));
    Entry(dialog).setText(QStringLiteral("games"));
    Press(dialog, QDialogButtonBox::Open);
  });
  EXPECT_EQ(Dialog.ShowFolder({.Filter = {}, .Folder = above.path().toStdString(), .Title = "Games"}),
            above.filePath(QStringLiteral("games")).toStdString());
  EXPECT_EQ(operatorAtWork.Runs(), 1);
}

TEST_F(QtFileDialogTest, GivesNoFolderOnCancel) {
  const WhileModal<QFileDialog> operatorAtWork([](QFileDialog& dialog) { dialog.reject(); });
  EXPECT_EQ(Dialog.ShowFolder({.Filter = {}}), std::nullopt);
}

}  // namespace
