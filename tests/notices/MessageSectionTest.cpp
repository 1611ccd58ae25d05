// Messages read through their sections as each section's record reads its own markup.
#include "tests/MessageSections.h"
#include "varnex3/notices/Xalo_Error.h"
#include "varnex3/notices/Xalo_VarnexReferenceData.h"
#include "varnex3/notices/Xalo_VarnexVersionChange.h"

using namespace varnex3;
using namespace varnex3::tests;

namespace {

// Version, source, destination and repairer alone: these notices have neither insurer nor claim.
SectionForms ShortEnvelope()
{
    const SectionForms all = Envelope();
    return {all[0], all[1], all[2], all[4]};
}

SectionForms SectionsOfVersionChange()
{
    SectionForms forms = ShortEnvelope();
    forms[0].inside = {u"XaloVersion", u"VarnexVersion", u"NextVarnexVersion", u"Version"};
    return forms;
}

SectionForms SectionsOfReferenceData()
{
    SectionForms forms = ShortEnvelope();
    forms.push_back({"ReferenceDataField",
                     u"ReferenceData",
                     u"<DataType Name=\"n\"/>",
                     {u"DataType", u"DataValue", u"Code", u"Description"}});
    return forms;
}

const SectionForm kErrorDetails = {"ErrorDetailsField",
                                   u"ErrorDetails",
                                   u"",
                                   {u"Severity", u"DataContentError", u"MessageOrderError", u"MessageTypeError",
                                    u"MiscellaneousError", u"Description", u"ElementName", u"Value",
                                    u"ExpectedMessageNo", u"ReceivedMessageNo", u"ErrorDetails"}};

template <class Message>
void CheckReadings(const SectionForms& forms, unsigned seed)
{
    const auto [read, failed] = CompareReadings<Message>(forms, u"", seed);
    CHECK(read > 100);
    CHECK(failed > 100);
}

// An error message with what it must have, and several error details.
Text ErrorMessage(Texts& texts)
{
    Text text = u"<Xalo_Error xmlns:p=\"urn:p\">";
    for (const SectionForm& form : Envelope())
        text += u"<" + form.element + u">" + form.least + u"</" + form.element + u">";
    for (std::size_t count = texts.Below(10); count > 0; --count)
        text += texts.Section(kErrorDetails) + u" text <!-- c -->";
    return text + u"</Xalo_Error>";
}

Outcome ReadDetailsByFragments(const Text& text)
{
    const auto message = New<Xalo_Error>();
    xml::Document document;
    document.LoadText(text);
    return OutcomeOf(*message, {kErrorDetails}, [&] {
        for (const xml::Node& node : document.Select("Xalo_Error/ErrorDetails"))
            message->ErrorDetailsField()->ParseXML(node.Xml());
    });
}

} // namespace

TEST_CASE("Each section reads from the whole message as from its own markup")
{
    CompareSections<Xalo_Error>(Envelope(), u"");
    CompareSections<Xalo_VarnexVersionChange>(SectionsOfVersionChange(), u"");
    CompareSections<Xalo_VarnexReferenceData>(SectionsOfReferenceData(), u"");
}

TEST_CASE("The whole message reads as its sections one by one, also to the same error")
{
    CheckReadings<Xalo_Error>(Envelope(), 31);
    CheckReadings<Xalo_VarnexVersionChange>(SectionsOfVersionChange(), 32);
    CheckReadings<Xalo_VarnexReferenceData>(SectionsOfReferenceData(), 33);
}

TEST_CASE("Error details read from the whole message as each from its own markup, also to the same error")
{
    Texts texts(34);
    int read = 0;
    int failed = 0;
    for (int i = 0; i < 1500; ++i) {
        const Text text = ErrorMessage(texts);
        CAPTURE(text);
        const Outcome whole = ReadWhole<Xalo_Error>({kErrorDetails}, text);
        const Outcome byFragments = ReadDetailsByFragments(text);
        CHECK(whole.error == byFragments.error);
        CHECK(whole.json == byFragments.json);
        ++(whole.error == "none" ? read : failed);
    }
    CHECK(read > 100);
    CHECK(failed > 10);
}
