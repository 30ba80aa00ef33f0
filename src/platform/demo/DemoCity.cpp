#include "platform/demo/DemoCity.h"

#include <algorithm>

namespace orvo::DemoCity {

const std::vector<Agency>& agencies() {
    static const std::vector<Agency> agencies = {
        {"mbt", "Marrow Bay Transit", "https://mbt.example"},
        {"hhr", "Harbour and Hills Railway", "https://hhr.example"},
    };
    return agencies;
}

const std::vector<Stop>& stops() {
    static const std::vector<Stop> stops = {
        {"airport", "Airport", 54.4210, 10.0910},
        {"northgate", "Northgate", 54.4015, 10.1302},
        {"central", "Central Station", 54.3853, 10.1346},
        {"market", "Market Square", 54.3821, 10.1401},
        {"university", "University", 54.3702, 10.1188},
        {"garden", "Botanical Garden", 54.3655, 10.1530},
        {"harbour", "Old Harbour", 54.3768, 10.1622},
        {"hospital", "Hospital", 54.3920, 10.1544},
        {"hillside", "Hillside", 54.3589, 10.1077},
        {"summit", "Lookout Summit", 54.3544, 10.0989},
        {"island", "Gull Island", 54.3661, 10.2217},
        {"coast", "Northern Coast", 54.4977, 10.2466},
    };
    return stops;
}

const std::vector<Line>& lines() {
    static const std::vector<Line> lines = {
        {"M1",
         "mbt",
         "M1",
         "Airport – Old Harbour",
         "Flughafen – Alter Hafen",
         1,
         "C8102E",
         "FFFFFF",
         {"airport", "northgate", "central", "harbour"}},
        {"M2",
         "mbt",
         "M2",
         "Northgate – University",
         "Nordtor – Universität",
         1,
         "0057B8",
         "FFFFFF",
         {"northgate", "central", "market", "university"}},
        {"T4",
         "mbt",
         "4",
         "Market Square – Botanical Garden",
         "Marktplatz – Botanischer Garten",
         0,
         "00843D",
         "FFFFFF",
         {"market", "harbour", "garden"}},
        {"T7",
         "mbt",
         "7",
         "Central Station – Hillside",
         "Hauptbahnhof – Am Hang",
         0,
         "F2A900",
         "000000",
         {"central", "university", "hillside"}},
        {"B12",
         "mbt",
         "12",
         "Hospital – Hillside",
         "Krankenhaus – Am Hang",
         3,
         "6F263D",
         "FFFFFF",
         {"hospital", "market", "university", "hillside"}},
        {"B48",
         "mbt",
         "48",
         "Northgate – Botanical Garden",
         "Nordtor – Botanischer Garten",
         3,
         "",
         "",
         {"northgate", "hospital", "garden"}},
        {"X90",
         "mbt",
         "X90",
         "Airport Express",
         "Flughafenexpress",
         702,
         "101820",
         "FFD100",
         {"airport", "central"}},
        {"N3",
         "mbt",
         "N3",
         "Night bus Central Station – Old Harbour",
         "Nachtbus Hauptbahnhof – Alter Hafen",
         3,
         "1B365D",
         "FFFFFF",
         {"central", "market", "harbour"}},
        {"S1",
         "hhr",
         "S1",
         "Central Station – Northern Coast",
         "Hauptbahnhof – Nordküste",
         2,
         "007A33",
         "FFFFFF",
         {"central", "northgate", "coast"}},
        {"CE",
         "hhr",
         "",
         "Coastal Express",
         "Küstenexpress",
         2,
         "5C068C",
         "FFFFFF",
         {"central", "coast"}},
        {"F1",
         "hhr",
         "F1",
         "Old Harbour – Gull Island",
         "Alter Hafen – Möweninsel",
         4,
         "00A3E0",
         "000000",
         {"harbour", "island"}},
        {"FUN", "hhr", "", "Hillside Funicular", "Hangbahn", 7, "", "", {"hillside", "summit"}},
        {"SKY",
         "hhr",
         "",
         "Skyline Cable Car",
         "Panorama-Seilbahn",
         6,
         "E87722",
         "000000",
         {"garden", "summit"}},
    };
    return lines;
}

const std::vector<std::string>& favoriteRouteIds() {
    static const std::vector<std::string> ids = {"M1", "M2", "T4", "B12", "S1", "F1", "SKY"};
    return ids;
}

const Stop& favoritePlace() {
    return *std::ranges::find(stops(), std::string("market"), &Stop::id);
}

} // namespace orvo::DemoCity
