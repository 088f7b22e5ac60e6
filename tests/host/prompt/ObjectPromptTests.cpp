#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr unsigned POINTS_AND_CURVES = 5;

/// A document with a mesh "Roof", a curve "Walk" and the points "Mark" and "North gate", and one
/// question for objects inside a command `Pick`.
class ObjectPromptTest : public HostTest {
protected:
    ObjectPromptTest() {
        objects().addMesh(L"Roof", {boxMesh({0, 0, 0}, {1, 1, 1})});
        const KM_3dPoint corners[] = {{0, 0, 0}, {5, 0, 0}};
        objects().addCurve(L"Walk", std::make_unique<KM_PolylineCurve>(corners));
        objects().addPoint(L"Mark", {1, 2, 3});
        objects().addPoint(L"North gate", {4, 5, 6});
    }

    ObjectTable& objects() { return Document::of(session.document()).objects(); }
    KM_UUID idOf(const wchar_t* name) { return objects().findByName(name)->id; }

    using Questioner = std::function<void(CQuarnGetObject&)>;

    void pick(const KM_wString& words, int minimum, int maximum, const Questioner& set_up = {}) {
        TestCommand command(L"Pick", [&](const CQuarnCommandContext&) {
            CQuarnGetObject get;
            get.SetCommandPrompt(L"Path");
            if (set_up)
                set_up(get);
            do {
                result = get.GetObjects(minimum, maximum);
                option = get.Option() ? get.Option()->m_option_index : option;
            } while (result == CQuarnGet::option);
            names.clear();
            for (int i = 0; i < get.ObjectCount(); ++i)
                names.push_back(KM_wString(get.Object(i).Object()->Name()).ToUtf8());
            outside = get.Object(get.ObjectCount());
            return get.CommandResult();
        });
        add(command);
        ended = run(L"Pick " + words);
    }

    CQuarnGet::result result = CQuarnGet::no_result;
    CQuarnCommand::result ended = CQuarnCommand::failure;
    int option = 0;
    std::vector<std::string> names;
    CQuarnObjRef outside{KM_CreateUuid()};
};

TEST_F(ObjectPromptTest, AnObjectIsNamedByItsNameInAnyCase) {
    pick(L"\"north GATE\"", 1, 1);
    EXPECT_EQ(result, CQuarnGet::object);
    EXPECT_EQ(static_cast<int>(result), 6);
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_THAT(names, ElementsAre("North gate"));
    EXPECT_TRUE(KM_UuidIsNil(outside.ObjectUuid()));
}

TEST_F(ObjectPromptTest, AnObjectIsNamedByItsIdWithOrWithoutBraces) {
    const KM_wString id = KM_UuidToString(idOf(L"Walk"));
    pick(id, 1, 1);
    EXPECT_THAT(names, ElementsAre("Walk"));
    pick(L"{" + id + L"}", 1, 1);
    EXPECT_THAT(names, ElementsAre("Walk"));
}

TEST_F(ObjectPromptTest, ANameWinsOverTheIdOfAnotherObject) {
    const KM_wString id = KM_UuidToString(idOf(L"Walk"));
    const KM_UUID impostor = objects().addPoint(id, {0, 0, 0}).id;
    pick(id, 1, 1);
    EXPECT_THAT(names, ElementsAre(id.ToUtf8()));
    EXPECT_NE(impostor, idOf(L"Walk"));
}

TEST_F(ObjectPromptTest, AHiddenObjectCanBeGiven) {
    objects().setVisible(idOf(L"Mark"), false);
    pick(L"Mark", 1, 1);
    EXPECT_THAT(names, ElementsAre("Mark"));
}

TEST_F(ObjectPromptTest, AnUnknownNameIsToldAndCancelsAScript) {
    pick(L"Nobody", 1, 1);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_EQ(ended, CQuarnCommand::cancel);
    EXPECT_EQ(printed(), "Pick: \"Nobody\" does not answer \"Path\". There is no object called "
                         "\"Nobody\"; List shows the names.\n");
}

TEST_F(ObjectPromptTest, TheFilterRefusesOtherKindsByName) {
    pick(L"Roof", 1, 1, [](CQuarnGetObject& get) { get.SetGeometryFilter(POINTS_AND_CURVES); });
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(printed(), HasSubstr("Roof is a mesh; pick a point or a curve.\n"));
    pick(L"Walk", 1, 1,
         [](CQuarnGetObject& get) { get.SetGeometryFilter(CQuarnGetObject::mesh_object); });
    EXPECT_THAT(printed(), HasSubstr("Walk is a curve; pick a mesh.\n"));
}

TEST_F(ObjectPromptTest, TheFilterAdmitsItsKinds) {
    for (const wchar_t* name : {L"Walk", L"Mark"}) {
        pick(name, 1, 1, [](CQuarnGetObject& get) { get.SetGeometryFilter(POINTS_AND_CURVES); });
        EXPECT_EQ(result, CQuarnGet::object);
    }
}

TEST_F(ObjectPromptTest, APersonIsToldABadNameAndAskedAgain) {
    for (const wchar_t* answer : {L"Nobody", L"Roof", L"north gate"})
        front_end.addAnswer(answer);
    pick(L"", 1, 1, [](CQuarnGetObject& get) { get.SetGeometryFilter(POINTS_AND_CURVES); });
    EXPECT_THAT(names, ElementsAre("North gate"));
    EXPECT_EQ(printed(), "There is no object called \"Nobody\"; List shows the names.\n"
                         "Roof is a mesh; pick a point or a curve.\n");
}

TEST_F(ObjectPromptTest, ThePersonIsShownTheNamesThatAreAdmitted) {
    for (const wchar_t* answer : {L"Mark", L"_Enter"})
        front_end.addAnswer(answer);
    pick(L"", 1, 0, [](CQuarnGetObject& get) { get.SetGeometryFilter(POINTS_AND_CURVES); });
    ASSERT_EQ(front_end.questions().size(), 2U);
    const Question& first = front_end.questions()[0];
    EXPECT_EQ(first.kind, Question::Kind::object);
    EXPECT_THAT(first.object_names,
                ElementsAre(KM_wString(L"Walk"), KM_wString(L"Mark"), KM_wString(L"North gate")));
    EXPECT_FALSE(first.accepts_nothing);
    EXPECT_THAT(front_end.questions()[1].object_names,
                ElementsAre(KM_wString(L"Walk"), KM_wString(L"North gate")));
    EXPECT_TRUE(front_end.questions()[1].accepts_nothing);
}

// ---- How many

TEST_F(ObjectPromptTest, OnePickLeavesTheNextWordAlone) {
    pick(L"Mark Walk", 1, 1);
    EXPECT_THAT(names, ElementsAre("Mark"));
}

TEST_F(ObjectPromptTest, WithoutAMaximumEnterEnds) {
    pick(L"Mark Roof Mark Walk _Enter", 1, 0);
    EXPECT_EQ(result, CQuarnGet::object);
    EXPECT_THAT(names, ElementsAre("Mark", "Roof", "Walk")) << "Mark counts once";
}

TEST_F(ObjectPromptTest, AScriptThatDoesNotEndTheObjectsIsCancelled) {
    pick(L"Mark Roof", 1, 0);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(names, IsEmpty());
    EXPECT_EQ(printed(), "Pick needs an answer to \"Path\"; none was given.\n");
}

TEST_F(ObjectPromptTest, EnterBeforeTheMinimumIsRefused) {
    pick(L"Mark _Enter", 2, 3);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(printed(), HasSubstr("Pick at least 2 objects."));
    pick(L"Mark Roof _Enter", 2, 3);
    EXPECT_THAT(names, ElementsAre("Mark", "Roof"));
    pick(L"Mark Roof Walk", 2, 3);
    EXPECT_EQ(names.size(), 3U);
}

TEST_F(ObjectPromptTest, EnterWithNoneIsNothingOnlyWhereNothingIsAccepted) {
    pick(L"_Enter", 1, 1, [](CQuarnGetObject& get) { get.AcceptNothing(true); });
    EXPECT_EQ(result, CQuarnGet::nothing);
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_THAT(names, IsEmpty());
    pick(L"_Enter", 1, 1);
    EXPECT_EQ(result, CQuarnGet::cancel);
}

TEST_F(ObjectPromptTest, EscapeLeavesNoObjects) {
    pick(L"Mark _Cancel", 1, 0);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(names, IsEmpty());
    EXPECT_EQ(printed(), "");
}

TEST_F(ObjectPromptTest, ADefaultNamesTheObjectThatEnterTakes) {
    pick(L"_Enter", 1, 1, [](CQuarnGetObject& get) { get.SetDefaultString(L"Walk"); });
    EXPECT_THAT(names, ElementsAre("Walk"));
}

// ---- Options

TEST_F(ObjectPromptTest, AnOptionWinsOverAnObjectOfItsNameUnlessQuoted) {
    objects().addPoint(L"All", {0, 0, 0});
    const Questioner with_all = [](CQuarnGetObject& get) {
        get.AddCommandOption({L"All", L"Alle"});
    };
    for (const wchar_t* word : {L"All", L"_all", L"Alle"}) {
        option = 0;
        pick(KM_wString(word) + L" Mark", 1, 1, with_all);
        EXPECT_EQ(option, 1) << KM_wString(word).ToUtf8();
        EXPECT_THAT(names, ElementsAre("Mark"));
    }
    option = 0;
    pick(L"\"All\"", 1, 1, with_all);
    EXPECT_EQ(option, 0);
    EXPECT_THAT(names, ElementsAre("All"));
    front_end.addAnswer(L"\"All\"");
    pick(L"", 1, 1, with_all);
    EXPECT_EQ(option, 0);
    EXPECT_THAT(names, ElementsAre("All"));
}

TEST_F(ObjectPromptTest, ObjectsGivenBeforeAnOptionStay) {
    pick(L"Mark Deeper Roof _Enter", 1, 0, [](CQuarnGetObject& get) {
        get.AddCommandOption({L"Deeper", L"Deeper"});
    });
    EXPECT_EQ(option, 1);
    EXPECT_THAT(names, ElementsAre("Mark", "Roof"));
}

// ---- The selection

class PreselectionTest : public ObjectPromptTest {
protected:
    PreselectionTest() {
        objects().findByName(L"Mark")->selected = true;
        objects().findByName(L"Walk")->selected = true;
    }
};

TEST_F(PreselectionTest, IsTakenWithoutAskingInTheDocumentsOrder) {
    pick(L"", 1, 0, [](CQuarnGetObject& get) { get.EnablePreSelect(true, false); });
    EXPECT_EQ(result, CQuarnGet::object);
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_THAT(names, ElementsAre("Walk", "Mark"));
    EXPECT_THAT(front_end.questions(), IsEmpty());
}

TEST_F(PreselectionTest, IsNotTakenUnlessEnabled) {
    pick(L"Roof", 1, 1);
    EXPECT_THAT(names, ElementsAre("Roof"));
    pick(L"Roof", 1, 1, [](CQuarnGetObject& get) { get.EnablePreSelect(false, true); });
    EXPECT_THAT(names, ElementsAre("Roof"));
}

TEST_F(PreselectionTest, OfMoreThanAreWantedIsNotTaken) {
    pick(L"Roof", 1, 1, [](CQuarnGetObject& get) { get.EnablePreSelect(true, true); });
    EXPECT_THAT(names, ElementsAre("Roof"));
}

TEST_F(PreselectionTest, LeavesOutWhatTheFilterRefusesOnlyWhereThatIsWished) {
    const auto only_points = [](CQuarnGetObject& get, bool ignore) {
        get.SetGeometryFilter(CQuarnGetObject::point_object);
        get.EnablePreSelect(true, ignore);
    };
    pick(L"", 1, 1, [&](CQuarnGetObject& get) { only_points(get, true); });
    EXPECT_THAT(names, ElementsAre("Mark"));
    pick(L"\"North gate\"", 1, 1, [&](CQuarnGetObject& get) { only_points(get, false); });
    EXPECT_THAT(names, ElementsAre("North gate"));
}

TEST_F(PreselectionTest, DoesNotReplaceObjectsThatWereGiven) {
    TestCommand command(L"Pick", [&](const CQuarnCommandContext&) {
        CQuarnGetObject get;
        get.AddCommandOption({L"Deeper", L"Deeper"});
        EXPECT_EQ(get.GetObjects(1, 0), CQuarnGet::option);
        get.EnablePreSelect(true, true);
        EXPECT_EQ(get.GetObjects(1, 0), CQuarnGet::object);
        EXPECT_EQ(get.ObjectCount(), 1);
        EXPECT_EQ(get.Object(0).ObjectUuid(), idOf(L"Roof"));
        return get.CommandResult();
    });
    add(command);
    EXPECT_EQ(run(L"Pick Roof Deeper _Enter"), CQuarnCommand::success);
}

// ---- What a reference tells

TEST_F(ObjectPromptTest, AReferenceGivesThePointOfAPointObjectOnly) {
    const CQuarnObjRef mark(idOf(L"Mark"));
    ASSERT_NE(mark.Point(), nullptr);
    EXPECT_EQ(*mark.Point(), KM_3dPoint(1, 2, 3));
    EXPECT_EQ(mark.Curve(), nullptr);
    EXPECT_EQ(CQuarnObjRef(idOf(L"Walk")).Point(), nullptr);
    EXPECT_EQ(CQuarnObjRef(idOf(L"Roof")).Point(), nullptr);
    EXPECT_EQ(CQuarnObjRef().Point(), nullptr);
    objects().remove(mark.ObjectUuid());
    EXPECT_EQ(mark.Point(), nullptr);
}

TEST(ObjectPrompt, OutsideACommandFailsAndIsTold) {
    ScriptedFrontEnd front_end;
    Session session{front_end, {{}, {}, "C", {}}};
    Document::of(session.document()).objects().addPoint(L"Mark", {0, 0, 0}).selected = true;
    CQuarnGetObject get;
    get.EnablePreSelect(true, true);
    BreachList breaches;
    EXPECT_EQ(get.GetObjects(1, 1), CQuarnGet::no_result);
    EXPECT_EQ(get.CommandResult(), CQuarnCommand::failure);
    EXPECT_EQ(get.ObjectCount(), 0);
    EXPECT_THAT(breaches.take(), ElementsAre("CQuarnGetObject::GetObjects: questions may be asked "
                                             "while a command runs"));
}

} // namespace
} // namespace quarn::test
