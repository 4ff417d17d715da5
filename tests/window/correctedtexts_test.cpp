#include <gtest/gtest.h>

#include <QComboBox>
#include <QPalette>

#include "ui/text.h"
#include "window/correctionstest.h"

namespace kdx::test {
namespace {

class CorrectedTextsTest : public CorrectionsTest {
protected:
    CorrectedTextsTest() {
        setDataSet1("RDS", "EON_PI", "D3C2");
        setDataSet1("RDS", "EON_PTY", "4");
    }
    static Lines types(const Lines& commands) { return beginning(commands, ":STEREO:DIRECT \"EON-PTY"); }
    /// What a file holds behind a key, as it stands there.
    std::string written(const char* file, const std::string& key) const {
        const std::string bytes = folder.read(file);
        const std::size_t at = bytes.find("\n" + key + "=") + key.size() + 2;
        return bytes.substr(at, bytes.find('\r', at) - at);
    }
    void answer(std::initializer_list<const char*> answers) {
        for (const char* text : answers) dialogs.inputs.push_back(QString::fromUtf8(text));
    }
    bool isRed(const char* entry) { return find<QLineEdit>(entry)->palette().color(QPalette::Text) == Qt::red; }
};

TEST_F(CorrectedTextsTest, TheOtherNetworksTypeGoesOutAsAPiAndIsStoredByNameAsDescribed) {
    EXPECT_EQ(types(openWith({})), Lines{});
    sent();
    find<QComboBox>("EON_PTY_Combo")->setCurrentIndex(10);
    EXPECT_EQ(sent(), Lines{direct("EON-PI=" + text("EON_PTY_Combo").substr(0, 4))});
    EXPECT_EQ(dataSet1("RDS", "EON_PTY"), text("EON_PTY_Combo"));
    EXPECT_EQ(types(sentBy("Btn_SetRdsStereo")), Lines{});
    start();
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 0);
}

TEST_F(CorrectedTextsTest, TheOtherNetworksTypeGoesOutAndIsStoredAsANumberWhenCorrected) {
    EXPECT_EQ(types(openWith({"EON_PTY"})), Lines{direct("EON-PTY=D3C2,4")});
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 4);
    sent();
    find<QComboBox>("EON_PTY_Combo")->setCurrentIndex(10);
    EXPECT_EQ(sent(), Lines{direct("EON-PTY=D3C2,10")});
    EXPECT_EQ(dataSet1("RDS", "EON_PTY"), "10");
    EXPECT_EQ(types(sentBy("Btn_SetRdsStereo")), Lines{direct("EON-PTY=D3C2,10")});
    start();
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 10);
}

TEST_F(CorrectedTextsTest, AStoredNameIsLookedUpInTheListWhenCorrected) {
    start();
    const std::string name = captions.programmeType(9);
    setDataSet1("RDS", "EON_PTY", name);
    EXPECT_EQ(types(openWith({"EON_PTY"})), Lines{direct("EON-PTY=D3C2,9")});
    EXPECT_EQ(toBytes(find<QComboBox>("EON_PTY_Combo")->currentText()), name);
    EXPECT_EQ(dataSet1("RDS", "EON_PTY"), name) << "until another one is chosen";
}

TEST_F(CorrectedTextsTest, AnUnknownTypeIsNotSentWhenCorrected) {
    for (const char* unknown : {"", "Polka", "32", "-1"}) {
        setDataSet1("RDS", "EON_PTY", unknown);
        EXPECT_EQ(types(openWith({"EON_PTY"})), Lines{}) << unknown;
    }
}

TEST_F(CorrectedTextsTest, ADecimalCommaGoesOutAsTypedAsDescribed) {
    openWith({});
    answer({"98,7"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 98,7MHZ"});
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98,7");
    answer({"abc", "98.7x"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 98.7xMHZ"});
}

TEST_F(CorrectedTextsTest, ADecimalCommaIsTakenForAPointWhenCorrected) {
    openWith({"Komma"});
    answer({"98,7"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 98.7MHZ"});
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.7");
    EXPECT_EQ(text("Status_17"), "98.7");
    answer({" 2,25 "});
    clickLabel("Input_AF_Freq_Label");
    EXPECT_EQ(sent(), Lines{":STEREO:AUDIO:FREQ 2.25KHZ"});
}

TEST_F(CorrectedTextsTest, ARefusalSaysWhyInTheBoxThatAsksAgainWhenCorrected) {
    openWith({"Komma"});
    answer({"98.7x", "120,5", "60,5"});
    clickLabel("Input_HF_Pegel_Label");
    EXPECT_EQ(sent(), Lines{":POW 60.5DBUV"});
    const auto& boxes = dialogs.shown;
    ASSERT_EQ(boxes.size(), 3U);
    const QString question = boxes[0].text;
    EXPECT_EQ(boxes[1].text, question + QStringLiteral("\n98.7x ist keine Zahl."));
    EXPECT_EQ(boxes[1].preset, QStringLiteral("98.7x"));
    EXPECT_EQ(boxes[2].text, question + QStringLiteral("\n120.5 liegt nicht zwischen 0 und 120."));
    EXPECT_EQ(boxes[2].preset, QStringLiteral("120.5"));
}

TEST_F(CorrectedTextsTest, AStoredDecimalCommaGoesOutAsAPointWhenCorrected) {
    setDataSet1("VRN", "HF_Frequenz", "98,7");
    setDataSet1("VRN", "HF_Pegel", "laut");
    EXPECT_EQ(beginning(openWith({}), "FREQ"), Lines{"FREQ 98,7MHZ"});
    const Lines corrected = openWith({"Komma"});
    EXPECT_EQ(beginning(corrected, "FREQ"), Lines{"FREQ 98.7MHZ"});
    EXPECT_EQ(beginning(corrected, ":POW"), Lines{}) << "no number";
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.7");
    EXPECT_EQ(beginning(sentBy("Btn_SetRdsStereo"), "FREQ"), Lines{"FREQ 98.7MHZ"});
}

TEST_F(CorrectedTextsTest, TheCycleTimeTakesADecimalCommaWhenCorrected) {
    for (const bool corrected : {false, true}) {
        if (corrected) {
            openWith({"Komma"});
        } else {
            openWith({});
        }
        click("TMC_Gr8_apply");
        type("txtCycleTime", "1,5");
        click("TMC_Senden_Taste");
        EXPECT_EQ(find<QTimer>("TMC_Sende_Timer")->interval(), corrected ? 1500 : 1000);
        EXPECT_EQ(text("txtCycleTime"), corrected ? "1.5" : "1,5");
    }
}

TEST_F(CorrectedTextsTest, AQuoteGoesOutAsTypedAsDescribed) {
    openWith({});
    type("PS_T", "A\"B");
    EXPECT_EQ(sentBy("PS_Taste"), Lines{direct("PS=A\"B     ")});
    EXPECT_TRUE(isRed("PS_T"));
    EXPECT_EQ(session->params.quotedKeys(), std::set<std::string>{"PS"});
}

TEST_F(CorrectedTextsTest, AQuoteGoesOutDoubledBehindPaddingAndCuttingWhenCorrected) {
    setDataSet1("RDS", "RTA", "sag \"ja\"");
    const Lines opening = openWith({"Anfuehrung"});
    EXPECT_EQ(std::count(opening.begin(), opening.end(), direct("RT=10,0,sag \"\"ja\"\"")), 1);
    EXPECT_FALSE(isRed("RT_Text1"));
    type("PS_T", "A\"B");
    EXPECT_EQ(sentBy("PS_Taste"), Lines{direct("PS=A\"\"B     ")});
    EXPECT_EQ(dataSet1("RDS", "PS"), "A\"B");
    EXPECT_EQ(text("Status_3"), "A\"B");
    EXPECT_FALSE(isRed("PS_T"));
    type("PS_T", "\"1234567890");
    EXPECT_EQ(sentBy("PS_Taste"), Lines{direct("PS=\"\"1234567")});
    type("EON_PS_Text", "\"\"");
    EXPECT_EQ(sentBy("EON_PS_Taste"), Lines{direct("EON-PS=D3C2,\"\"\"\"      ")});
    type("RT_Text1", "\"");
    EXPECT_EQ(sentBy("RT_Taste1"), Lines{direct("RT=10,0,\"\"")});
    EXPECT_TRUE(session->params.quotedKeys().empty()) << "no text is ended early";
}

TEST_F(CorrectedTextsTest, BlanksAtTheEdgesOfStoredTextsAreLostAsDescribed) {
    openWith({});
    type("PS_T", " A B ");
    EXPECT_EQ(sentBy("PS_Taste"), Lines{direct("PS= A B    ")});
    EXPECT_EQ(written(kSet1, "PS"), " A B ");
    EXPECT_EQ(dataSet1("RDS", "PS"), "A B");
    start();
    EXPECT_EQ(text("PS_T"), "A B");
}

TEST_F(CorrectedTextsTest, BlanksAtTheEdgesOfStoredTextsComeBackWhenCorrected) {
    openWith({"PS_Rand"});
    type("PS_T", "  MID   ");
    EXPECT_EQ(sentBy("PS_Taste"), Lines{direct("PS=  MID   ")});
    type("EON_PS_Text", " EON");
    EXPECT_EQ(sentBy("EON_PS_Taste"), Lines{direct("EON-PS=D3C2, EON    ")});
    type("RT_Text1", "Text ");
    EXPECT_EQ(sentBy("RT_Taste1"), Lines{direct("RT=10,0,Text ")});
    EXPECT_EQ(written(kSet1, "PS"), "\"  MID   \"");
    EXPECT_EQ(written(kSet1, "EON_PS"), "\" EON\"");
    EXPECT_EQ(written(kSet1, "RTA"), "\"Text \"");
    start();
    EXPECT_EQ(text("PS_T"), "  MID   ");
    EXPECT_EQ(text("EON_PS_Text"), " EON");
    EXPECT_EQ(text("RT_Text1"), "Text ");
    const Lines opening = opened();
    for (const char* command : {"PS=  MID   ", "EON-PS=D3C2, EON    ", "RT=10,0,Text "}) {
        EXPECT_EQ(std::count(opening.begin(), opening.end(), direct(command)), 1) << command;
    }
    type("PS_T", "MITTE");
    click("PS_Taste");
    EXPECT_EQ(written(kSet1, "PS"), "MITTE");
}

}  // namespace
}  // namespace kdx::test
