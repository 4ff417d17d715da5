#include "ui/qtdialogs.h"
#include "support/sourcefolder.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QInputDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QTemporaryFile>
#include <QTimer>
#include <QWindow>

#include <functional>

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "ui/text.h"

namespace kdx {
namespace {

/// The real boxes, each met by a user who looks at it and then presses something.
class QtDialogsTest : public ::testing::Test {
protected:
    QtDialogsTest() { captions.load("english", "RDS"); }

    template <typename Box>
    void meet(const std::function<void(Box& box)>& user) {
        QTimer::singleShot(0, qApp, [this, user] {
            auto* box = qobject_cast<Box*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            met = true;
            user(*box);
        });
    }
    static QPushButton* button(const QWidget& box, const char* caption) {
        for (QPushButton* found : box.findChildren<QPushButton*>()) {
            if (found->text() == QLatin1String(caption)) return found;
        }
        throw std::runtime_error(std::string("no button ") + caption);
    }

    DataFolder data{test::sourceFolder()};
    Captions captions{data};
    QtDialogs dialogs{captions};
    bool met = false;
};

TEST_F(QtDialogsTest, AMessageShowsItsPartsAsPlainText) {
    meet<QMessageBox>([](QMessageBox& box) {
        EXPECT_EQ(box.windowTitle(), QString());
        EXPECT_EQ(box.text(), QStringLiteral("<b>\nline"));
        EXPECT_EQ(box.informativeText(), QStringLiteral("details"));
        EXPECT_EQ(box.textFormat(), Qt::PlainText);
        EXPECT_EQ(box.icon(), QMessageBox::Warning);
        EXPECT_TRUE(box.isModal());
        button(box, "OK")->click();
    });
    dialogs.message(Dialogs::Icon::Exclamation, QString(), QStringLiteral("<b>\nline"), QStringLiteral("details"));
    EXPECT_TRUE(met);
}

TEST_F(QtDialogsTest, AFailureBearsTheCriticalIcon) {
    meet<QMessageBox>([](QMessageBox& box) {
        EXPECT_EQ(box.windowTitle(), QStringLiteral("Interface Error"));
        EXPECT_EQ(box.icon(), QMessageBox::Critical);
        box.reject();
    });
    dialogs.message(Dialogs::Icon::Critical, QStringLiteral("Interface Error"), QStringLiteral("Fehler: -1"));
    EXPECT_TRUE(met);
}

TEST_F(QtDialogsTest, OnlyItsOwnButtonStopsASequence) {
    const auto answer = [this](const std::function<void(QMessageBox&)>& user) {
        meet<QMessageBox>(user);
        return dialogs.messageOrStop(QStringLiteral("Interface Error"), QStringLiteral("Fehler: -1"));
    };
    EXPECT_FALSE(answer([](QMessageBox& box) { button(box, "OK")->click(); }));
    EXPECT_FALSE(answer([](QMessageBox& box) { box.reject(); }));  // the escape key
    EXPECT_TRUE(answer([](QMessageBox& box) {
        EXPECT_EQ(box.icon(), QMessageBox::Critical);
        button(box, "&Stop the rest")->click();
    }));
}

TEST_F(QtDialogsTest, AQuestionIsAnsweredByYesAndNo) {
    const auto answer = [this](const std::function<void(QMessageBox&)>& user) {
        meet<QMessageBox>(user);
        return dialogs.confirm(QStringLiteral("AF list"), QStringLiteral("Delete?"));
    };
    EXPECT_TRUE(answer([](QMessageBox& box) { button(box, "&Yes")->click(); }));
    EXPECT_FALSE(answer([](QMessageBox& box) { button(box, "&No")->click(); }));
    EXPECT_FALSE(answer([](QMessageBox& box) { box.reject(); }));
}

TEST_F(QtDialogsTest, ReturnLosesNothing) {
    const auto isDefault = [](const QMessageBox& box, const char* caption) {
        return button(box, caption)->isDefault();
    };
    meet<QMessageBox>([&](QMessageBox& box) {
        EXPECT_TRUE(isDefault(box, "&No"));
        button(box, "&Yes")->click();
    });
    EXPECT_TRUE(dialogs.confirmLoss(QStringLiteral("Data set"), QStringLiteral("Overwrite?")));
    meet<QMessageBox>([&](QMessageBox& box) {
        EXPECT_TRUE(isDefault(box, "&Yes"));
        box.reject();
    });
    EXPECT_FALSE(dialogs.confirm(QStringLiteral("Data set"), QStringLiteral("Send?")));
}

TEST_F(QtDialogsTest, ATitleIsNotCutOff) {
    meet<QMessageBox>([](QMessageBox& box) {
        EXPECT_GE(box.sizeHint().width(), 50 * box.fontMetrics().averageCharWidth());
        box.reject();
    });
    dialogs.message(Dialogs::Icon::Critical, QStringLiteral("Interface Error"), QStringLiteral("short"));
}

TEST_F(QtDialogsTest, AnInputGivesWhatWasTypedAndNothingWhenCancelled) {
    const auto answer = [this](const std::function<void(QInputDialog&)>& user) {
        meet<QInputDialog>(user);
        return dialogs.input(QStringLiteral("Please enter here: "), QStringLiteral("IEC Adress."),
                             QStringLiteral("28"));
    };
    EXPECT_EQ(answer([](QInputDialog& box) {
                  EXPECT_EQ(box.windowTitle(), QStringLiteral("IEC Adress."));
                  EXPECT_EQ(box.labelText(), QStringLiteral("Please enter here: "));
                  EXPECT_EQ(box.textValue(), QStringLiteral("28"));
                  box.findChild<QLineEdit*>()->setText(QStringLiteral(" 17 "));
                  button(box, "OK")->click();
              }),
              QStringLiteral(" 17 "));
    EXPECT_EQ(answer([](QInputDialog& box) { button(box, "Cancel")->click(); }), QString());
}

TEST_F(QtDialogsTest, NothingOpensOnceTheProgramEnds) {
    QtDialogs ending(captions, [] { return true; });
    ending.message(Dialogs::Icon::Critical, QString(), QStringLiteral("Fehler: -1"));
    EXPECT_TRUE(ending.messageOrStop(QString(), QStringLiteral("Fehler: -1")));
    EXPECT_FALSE(ending.confirm(QString(), QStringLiteral("Delete?")));
    EXPECT_EQ(ending.input(QString(), QString(), QStringLiteral("28")), QString());
}

TEST_F(QtDialogsTest, ABoxThatTheEndOfTheProgramClosesStopsWhatRuns) {
    bool ends = false;
    QtDialogs ending(captions, [&ends] { return ends; });
    meet<QMessageBox>([&ends](QMessageBox& box) {
        ends = true;
        box.close();
    });
    EXPECT_TRUE(ending.messageOrStop(QString(), QStringLiteral("Fehler: -1")));
    EXPECT_TRUE(met);
}

TEST_F(QtDialogsTest, AnAnswerHasNoControlCharacters) {
    meet<QInputDialog>([](QInputDialog& box) {
        box.setTextValue(QStringLiteral(" lab\r\n7\t"));
        box.accept();
    });
    EXPECT_EQ(dialogs.input(QString(), QString(), QString()), QStringLiteral(" lab 7"));
}

TEST_F(QtDialogsTest, TheAboutBoxHasNoTitleAndDetailsToBeOpened) {
    meet<QMessageBox>([](QMessageBox& box) {
        EXPECT_EQ(box.windowTitle(), QString());
        EXPECT_EQ(box.windowHandle()->title(), QStringLiteral(" ")) << "an empty one would become the program's name";
        EXPECT_EQ(box.icon(), QMessageBox::Warning);
        EXPECT_EQ(box.text(), QStringLiteral("Text"));
        EXPECT_EQ(box.informativeText(), QStringLiteral("Made of"));
        EXPECT_EQ(box.detailedText(), QStringLiteral("Tried"));
        button(box, "&Details")->click();
        QCoreApplication::processEvents();
        EXPECT_EQ(button(box, "&Details")->text(), QStringLiteral("&Details"));
        button(box, "OK")->click();
    });
    dialogs.about(QStringLiteral("Text"), QStringLiteral("Made of"), QStringLiteral("Tried"));
    EXPECT_TRUE(met);
}

TEST_F(QtDialogsTest, AnAboutBoxWithoutDetailsHasOneButton) {
    meet<QMessageBox>([](QMessageBox& box) {
        EXPECT_EQ(box.buttons().size(), 1);
        box.close();
    });
    dialogs.about(QStringLiteral("Text"), QStringLiteral("Made of"), QString());
}

TEST_F(QtDialogsTest, AFileThatIsThereIsOverwrittenAfterAQuestionOnly) {
    QTemporaryFile file;
    ASSERT_TRUE(file.open());
    const auto choose = [&file](QFileDialog& box) {
        box.selectFile(file.fileName());
        static_cast<QDialog&>(box).accept();
    };
    meet<QFileDialog>([&](QFileDialog& first) {
        meet<QMessageBox>([&](QMessageBox& question) {
            EXPECT_EQ(question.text(), QStringLiteral("Overwrite %1?").arg(QFileInfo(file.fileName()).fileName()));
            meet<QFileDialog>([&](QFileDialog& again) {
                meet<QMessageBox>([](QMessageBox& second) { button(second, "&Yes")->click(); });
                choose(again);
            });
            button(question, "&No")->click();
        });
        choose(first);
    });
    EXPECT_EQ(dialogs.fileToSave(QString(), QString(), QStringLiteral("All (*)")), file.fileName());
}

TEST_F(QtDialogsTest, AFileToOpenIsChosenInABox) {
    QTemporaryFile file;
    ASSERT_TRUE(file.open());
    meet<QFileDialog>([&](QFileDialog& box) {
        EXPECT_EQ(box.windowTitle(), QStringLiteral("Title"));
        box.selectFile(file.fileName());
        static_cast<QDialog&>(box).accept();
    });
    EXPECT_EQ(dialogs.fileToOpen(QStringLiteral("Title"), QStringLiteral("All (*)")), file.fileName());
}

TEST_F(QtDialogsTest, WithoutALanguageFileTheButtonsReadAsDesigned) {
    captions.load("none", "RDS");
    meet<QMessageBox>([](QMessageBox& box) { button(box, "&Nein")->click(); });
    EXPECT_FALSE(dialogs.confirm(QString(), QString()));
    EXPECT_TRUE(met);
}

}  // namespace
}  // namespace kdx
