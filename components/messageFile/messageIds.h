#pragma once

#include "components/messageFile/typedMessage.h"

// Every numbered message of the library: its name in the code, its number and the types of its arguments.
//
// Texts: messages/<language>.msg, one for each number. Those of the first list stand around other texts, given as
// arguments, so that a user sees where a fault lies and what it is.

// clang-format off

// Wrappers and what any format reports.
#define OVPHOTO_MESSAGES_GENERAL(message) \
    message(daylightLine,     12896, std::wstring, int)  /* detail, line */ \
    message(nimbLine,         12897, int, std::wstring)  /* line, detail */ \
    message(webRefused,       12935) \
    message(outOfMemory,      12936) \
    message(fileNotRead,      12945, std::wstring)  /* detail */ \
    message(textSetOff,       13082, std::wstring)  /* the text */ \
    message(webNotSaved,      13083, std::wstring)  /* name of the web */ \
    message(formatOnlyRead,   13084, std::wstring)  /* name of the format */

// Natural light, text form: the line that is missing or malformed. Put into 12896 as they stand.
#define OVPHOTO_MESSAGES_NATURAL_LIGHT(message) \
    message(daylightHeader,                   12898) \
    message(daylightOnOff,                    12899) \
    message(daylightOnOffWord,                12900) \
    message(daylightInOut,                    12901) \
    message(daylightInOutWord,                12902) \
    message(daylightNorth,                    12903) \
    message(daylightLatitude,                 12904) \
    message(daylightLongitude,                12905) \
    message(daylightDay,                      12906) \
    message(daylightSaving,                   12907) \
    message(daylightSavingWord,               12908) \
    message(daylightLocalTime,                12909) \
    message(daylightTimeZone,                 12910) \
    message(daylightSkyCover,                 12911) \
    message(daylightSunColor,                 12912) \
    message(daylightSkyColor,                 12913) \
    message(daylightOverwritePosition,        12914) \
    message(daylightOverwritePositionWord,    12915) \
    message(daylightSolarAltitude,            12916) \
    message(daylightSolarAzimuth,             12917) \
    message(daylightOverwriteIlluminance,     12918) \
    message(daylightOverwriteIlluminanceWord, 12919) \
    message(daylightDirectNormalIlluminance,  12920) \
    message(daylightSkyCastsShadows,          12921) \
    message(daylightSunFlags,                 12922) \
    message(daylightSkyFlags,                 12923) \
    message(daylightSkyShadowsAccuracy,       12924) \
    message(daylightNotFinite,                13081, std::wstring)  /* line; this one stands alone */

// Installing a web.
#define OVPHOTO_MESSAGES_WEB(message) \
    message(verticalAnglesNotAscending,   12925) \
    message(horizontalAnglesNotAscending, 12926) \
    message(firstHorizontalAngleNotZero,  12927) \
    message(fullRange,                    12928) \
    message(halfRange,                    12929) \
    message(quarterRange,                 12930) \
    message(axialCount,                   12931)

// IES: converting the record, by photometric type.
#define OVPHOTO_MESSAGES_IES_CONVERT(message) \
    message(typeAVerticalRange,        12932) \
    message(typeAHorizontalCount,      12933) \
    message(typeAHorizontalRange,      12934) \
    message(typeBVerticalRange,        12937) \
    message(typeBHorizontalCount,      12938) \
    message(typeBHorizontalRange,      12939) \
    message(typeCVerticalRange,        12940) \
    message(typeCLastHorizontalAngle,  12941, double)  /* angle */ \
    message(typeCFirstHorizontalAngle, 12942, double)  /* angle */ \
    message(verticalAnglesDecrease,    12943) \
    message(horizontalAnglesDecrease,  12944)

// IES and CIBSE: reading.
#define OVPHOTO_MESSAGES_READ(message) \
    message(numberNotConverted, 12946) \
    message(integerExpected,    12947, wchar_t)  /* character */ \
    message(floatExpected,      12948, wchar_t)  /* character */ \
    message(tiltGeometry,       12949, int)  /* value */ \
    message(tiltPairCount,      12950, int)  /* value */ \
    message(tiltFirstAngle,     12951, double)  /* angle */ \
    message(tiltAngleOrder,     12952, double, double)  /* previous angle, angle */ \
    message(tiltLastAngle,      12953, double)  /* angle */ \
    message(tiltAngles,         12954, int)  /* pairs */ \
    message(tiltFactors,        12955, int)  /* pairs */ \
    message(tiltLineMissing,    12956) \
    message(tiltFileNotFound,   12957, std::wstring)  /* name */ \
    message(tiltFileNotOpened,  12958, std::wstring)  /* path */ \
    message(lampCount,          12959, int)  /* value */ \
    message(verticalCount,      12960, int)  /* value */ \
    message(horizontalCount,    12961, int)  /* value */ \
    message(photometricType,    12962, int)  /* value */ \
    message(unitsType,          12963, int)  /* value */ \
    message(dimensions,         12964) \
    message(factors,            12965) \
    message(verticalAngle,      12966) \
    message(horizontalAngle,    12967) \
    message(candela,            12968)

// NIMB.
#define OVPHOTO_MESSAGES_NIMB(message) \
    message(nimbEndOfFile,           12970) \
    message(nimbHeaderFields,        12971, int)  /* fields */ \
    message(nimbMagic,               12972) \
    message(nimbLastHorizontalAngle, 12973, int)  /* angle */ \
    message(nimbLastVerticalAngle,   12974, int)  /* angle */ \
    message(nimbHorizontalStep,      12975, int)  /* step */ \
    message(nimbVerticalStep,        12976, int)  /* step */ \
    message(nimbOrientation,         12977, int)  /* angle */ \
    message(nimbSymmetryCode1,       12978, int)  /* code */ \
    message(nimbSymmetryCode2,       12979, int)  /* code */ \
    message(nimbLineFields,          12980, int)  /* fields */ \
    message(nimbNotWritten,          12981)

// CIBSE.
#define OVPHOTO_MESSAGES_CIBSE(message) \
    message(cibseType2VerticalRange,        12982) \
    message(cibseType2HorizontalCount,      12983) \
    message(cibseType2HorizontalRange,      12984) \
    message(cibseType1VerticalRange,        12985) \
    message(cibseType1LastHorizontalAngle,  12986, double)  /* angle */ \
    message(cibseType1FirstHorizontalAngle, 12987, double)  /* angle */ \
    message(cibseFirstLine,                 12989) \
    message(cibseNinthNumber,               12990) \
    message(cibseTrailer,                   12991)

// TBT: descriptions of a token (of at most 63 characters each), wrappers, details.
#define OVPHOTO_MESSAGES_TBT(message) \
    message(tbtTokenNumber,            12993, std::wstring)  /* the token */ \
    message(tbtTokenZeroFill,          12994, std::wstring)  /* the token */ \
    message(tbtTokenEnd,               12995, std::wstring)  /* the token */ \
    message(tbtTokenEndOfFile,         12996) \
    message(tbtTokenOther,             12997, std::wstring)  /* the token */ \
    message(tbtSyntaxError,            12998, int, std::wstring, std::wstring)  /* line feeds, detail, token's description or empty */ \
    message(tbtValueError,             12999, int, std::wstring)  /* line feeds, detail */ \
    message(tbtResourceError,          13000, int)  /* number of the message */ \
    message(tbtKindCodeMissing,        13002) \
    message(tbtKind4Value,             13003) \
    message(tbtKind5Second,            13004) \
    message(tbtKind5First,             13005) \
    message(tbtKind6Value,             13006) \
    message(tbtKindCode,               13007, int)  /* code */ \
    message(tbtTripleRange,            13008, double, double, double)  /* the three values */ \
    message(tbtTripleMissing,          13009) \
    message(tbtFluxMissing,            13010) \
    message(tbtFlux,                   13011, double)  /* flux */ \
    message(tbtReferenceFluxMissing,   13012) \
    message(tbtReferenceFlux,          13013, double)  /* flux */ \
    message(tbtMultiplierMissing,      13014) \
    message(tbtAuxValue1Missing,       13015) \
    message(tbtAuxValue2Missing,       13016) \
    message(tbtAuxValue3Missing,       13017) \
    message(tbtSymmetryCodeMissing,    13018) \
    message(tbtSymmetryCode,           13019, int)  /* code */ \
    message(tbtVerticalCountMissing,   13020) \
    message(tbtVerticalCount,          13021, int)  /* count */ \
    message(tbtHorizontalCountMissing, 13022) \
    message(tbtHorizontalCount,        13023, int)  /* count */ \
    message(tbtValueMissing,           13024) \
    message(tbtEndMissing,             13025)

// Names of the months.
#define OVPHOTO_MESSAGES_MONTHS(message) \
    message(monthJanuary,        13026) \
    message(monthJanuaryShort,   13027) \
    message(monthFebruary,       13028) \
    message(monthFebruaryShort,  13029) \
    message(monthMarch,          13030) \
    message(monthMarchShort,     13031) \
    message(monthApril,          13032) \
    message(monthAprilShort,     13033) \
    message(monthMay,            13034) \
    message(monthMayShort,       13080) \
    message(monthJune,           13035) \
    message(monthJuneShort,      13036) \
    message(monthJuly,           13037) \
    message(monthJulyShort,      13038) \
    message(monthAugust,         13039) \
    message(monthAugustShort,    13040) \
    message(monthSeptember,      13041) \
    message(monthSeptemberShort, 13042) \
    message(monthOctober,        13043) \
    message(monthOctoberShort,   13044) \
    message(monthNovember,       13045) \
    message(monthNovemberShort,  13046) \
    message(monthDecember,       13047) \
    message(monthDecemberShort,  13048)

// Names of the time zones; offsets in hours, west positive.
#define OVPHOTO_MESSAGES_ZONES(message) \
    message(zoneNewfoundland,     13054)  /* 3.5 */ \
    message(zoneAtlantic,         13055)  /* 4 */ \
    message(zoneEastern,          13056)  /* 5 */ \
    message(zoneCentral,          13057)  /* 6 */ \
    message(zoneMountain,         13058)  /* 7 */ \
    message(zonePacific,          13059)  /* 8 */ \
    message(zoneAlaska,           13060)  /* 9 */ \
    message(zoneHawaii,           13061)  /* 10 */ \
    message(zoneSamoa,            13062)  /* 11 */ \
    message(zoneNewZealand,       13063)  /* -12 */ \
    message(zoneSolomonIslands,   13049)  /* -11 */ \
    message(zoneEasternAustralia, 13064)  /* -10 */ \
    message(zoneCentralAustralia, 13065)  /* -9.5 */ \
    message(zoneJapan,            13066)  /* -9 */ \
    message(zoneChina,            13067)  /* -8 */ \
    message(zoneWesternAustralia, 13068)  /* -8 */ \
    message(zoneMalaya,           13069)  /* -7.5 */ \
    message(zoneIndochina,        13070)  /* -7 */ \
    message(zoneMyanmar,          13071)  /* -6.5 */ \
    message(zoneBangladesh,       13050)  /* -6 */ \
    message(zoneIndia,            13072)  /* -5.5 */ \
    message(zonePakistan,         13051)  /* -5 */ \
    message(zoneGulf,             13052)  /* -4 */ \
    message(zoneMoscow,           13073)  /* -3 */ \
    message(zoneEasternEurope,    13074)  /* -2 */ \
    message(zoneSouthAfrica,      13075)  /* -2 */ \
    message(zoneCentralEurope,    13076)  /* -1 */ \
    message(zoneGreenwich,        13077)  /* 0 */ \
    message(zoneAzores,           13078)  /* 1 */ \
    message(zoneMidAtlantic,      13053)  /* 2 */ \
    message(zoneBrasilia,         13079)  /* 3 */

// clang-format on

#define OVPHOTO_MESSAGES(message)           \
    OVPHOTO_MESSAGES_GENERAL(message)       \
    OVPHOTO_MESSAGES_NATURAL_LIGHT(message) \
    OVPHOTO_MESSAGES_WEB(message)           \
    OVPHOTO_MESSAGES_IES_CONVERT(message)   \
    OVPHOTO_MESSAGES_READ(message)          \
    OVPHOTO_MESSAGES_NIMB(message)          \
    OVPHOTO_MESSAGES_CIBSE(message)         \
    OVPHOTO_MESSAGES_TBT(message)           \
    OVPHOTO_MESSAGES_MONTHS(message)        \
    OVPHOTO_MESSAGES_ZONES(message)

namespace OvPhotometrics::messages {

OVPHOTO_DEFINE_MESSAGES(OVPHOTO_MESSAGES)

}  // namespace OvPhotometrics::messages
