// Every public class and module, as types, folder by folder: what the faces offer, in the order of the documentation.
//
// A new class has one line here. Library.h gives the same list as plain data.
#pragma once

#include "varnex3/varnex3.h"

namespace varnex3 {

template <class... Class>
struct ClassList
{};

// The lists of several folders.
template <class... List>
struct Folders
{};

template <class... Lists>
struct JoinedLists;
template <class... A>
struct JoinedLists<ClassList<A...>>
{
    using List = ClassList<A...>;
};
template <class... A, class... B, class... Rest>
struct JoinedLists<ClassList<A...>, ClassList<B...>, Rest...> : JoinedLists<ClassList<A..., B...>, Rest...>
{};
template <class First, class... List>
struct JoinedLists<First, Folders<List...>> : JoinedLists<First, List...>
{};

using ModuleList = ClassList<modGeneral, modFunctions>;

using CoreClasses = ClassList<
    // envelope
    VersionDef, SourceDef, DestinationDef, XaloBase,
    // parties
    InsurerDetailDef, RepairerDef, RepairerOptDef, InsurerDef, InsurerOptDef,
    // claim, vehicle and customer
    ClaimHeaderDef, VehicleDef, CustomerDef, PersonalNameDef>;

using RequestClasses =
    ClassList<Xalo_RequestForQuote, RequestDetailsDef, DamagedAreasDef, ClaimantTypeDef, VehicleModsDef>;

using QuoteClasses = ClassList<
    // the message, its status and inspection
    Xalo_Quote, VarnexStatusDef, InspectionDef,
    // header
    QuoteDetailsDef, OwnersContributionToCollectDef, VehicleDetailsDef, VehicleDetailsDefOdometer, HourlyRatesDef,
    TotalsDef, AssessmentDef,
    // items and their kinds
    QuoteItemsDef, QuoteItem, QuoteHoursDef, QuoteItemPaintLabour, QuoteItemPaintMaterials, QuoteItemPart,
    QuoteItemPartPartSource, QuoteItemMiscellaneous, QuoteItemMiscellaneousSublet, QuoteItemTowing, PartNumberDef>;

using OutcomeClasses = ClassList<
    // invoices
    Xalo_TaxInvoice, Xalo_AdjustmentNote, Xalo_ReactivateInvoice, TaxInvoiceDetailsDef, AdjustmentNoteDetailsDef,
    PaymentDetailsDef,
    // what comes of payment
    Xalo_PaymentAuthorised, Xalo_PaymentDeclined, PayAuthorityDetailsDef, ExpectedPaymentDetailsDef,
    // what else ends a job
    Xalo_Declined, DeclinedDetailDef, Xalo_JobCancelled>;

using NoticesClasses = ClassList<
    // errors
    Xalo_Error, ErrorDetailsDef, ErrorDetailsItem, ErrorDetailsDefDataContentError, ErrorDetailsDefMessageOrderError,
    ErrorDetailsDefMessageTypeError, ErrorDetailsDefMiscellaneousError,
    // images
    Xalo_Image,
    // versions and reference data
    Xalo_VarnexVersionChange, VersionChangeDef, Xalo_VarnexReferenceData, ReferenceDataDef, ReferenceDataDefDataType,
    ReferenceDataDefDataTypeDataValue, VarnexReferenceDataEnum>;

using InboxClasses = ClassList<MessageDef, Xalo_Messages>;

using ClassFolders = Folders<CoreClasses, RequestClasses, QuoteClasses, OutcomeClasses, NoticesClasses, InboxClasses>;

using PublicClasses = JoinedLists<ModuleList, ClassFolders>::List;

} // namespace varnex3
