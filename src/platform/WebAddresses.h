#pragma once

#include <QLatin1String>

// Every outside web address the program knows. The maker's addresses are placeholders
// under a reserved domain until the project has a web server of its own: nothing is
// fetched from, or run from, a host the project does not control.
namespace web {

// The emulator's own web site.
inline constexpr QLatin1String kZ26HomePage{"https://www.whimsey.com/z26/"};

// The maker's web server: its root is the program's home page, and it serves the update
// description file and the forum.
inline constexpr QLatin1String kMakerWebServer{"https://lum.example.org"};
inline constexpr QLatin1String kLumHomePage{"https://lum.example.org/"};
// Paths on the update server (the maker's web server unless $LUM_UPDATE_URL or a test
// points elsewhere).
inline constexpr QLatin1String kUpdateServer{"https://lum.example.org"};
inline constexpr QLatin1String kUpdateDescriptionPath{"/programs/update.txt"};
inline constexpr QLatin1String kForumPath{"/forum"};

// The game-information site; the main window adds "/software_page.html?SoftwareID=".
inline constexpr QLatin1String kGameInfoSite{"https://atariage.com"};

// Support e-mail, used in the About window's mailto link.
inline constexpr QLatin1String kSupportEmail{"support@lum.example.org"};

// The donation link is made of the payment service's page, the maker's payment address
// and the site name the payment is for.
inline constexpr QLatin1String kDonationService{"https://www.paypal.com"};
inline constexpr QLatin1String kDonationEmail{"donate@lum.example.org"};
inline constexpr QLatin1String kDonationSiteName{"lum.example.org"};

} // namespace web
