#include "host/logon.h"

#include "base/rounding.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "host/blocking.h"
#include "host/errors.h"
#include "host/texts.h"

namespace zebtell::host {
namespace {

using base::EqualNoCase;
using data::DataApplication;
using data::Record;

constexpr LocalText kInvalid = {"Vale kasutajanimi või parool!",
                                "Invalid user name or password!",
                                "Nederīgs lietotājvārds vai parole!"};

// Nobody's fault who logs on, so it does not count as an attempt.
constexpr LocalText kNotAvailable = {
    "Teenus ei ole praegu kättesaadav, palun proovige mõne aja pärast uuesti!",
    "The service is not available at the moment, please try again later!",
    "Pakalpojums pašlaik nav pieejams, lūdzu, mēģiniet vēlāk!"};

struct Credentials {
    std::string user;
    std::string password;
};

// What the form says; nobody's name, or the guest's, logs the guest on.
Credentials ReadCredentials(SessionState& state,
                            const web::Request& request,
                            const Settings& settings) {
    Credentials typed{request.Form["ZEB_IN_KASUTAJATUNNUS"], request.Form["ZEB_IN_PAROOL"]};
    state.logon.IsGuest = typed.user.empty() || EqualNoCase(typed.user, settings.DispName);
    if (state.logon.IsGuest) typed = {settings.UserID, settings.PassWord};
    return typed;
}

std::int64_t LinkID(Record& record, std::string_view field) {
    const base::Value value = record.GetField(field);
    return value.IsBlank() ? 0 : value.ToInteger64();
}

std::shared_ptr<Record> LoadLinked(DataApplication& application,
                                   std::string_view table,
                                   std::int64_t id) {
    return id == 0 ? nullptr : application.Load(table, id);
}

double PriceFactor(Record& user) {
    const base::Value cut = user.GetField("Partner.PriceCut");
    return cut.IsBlank() ? 1 : (100 + cut.ToDouble()) / 100;
}

// The partner's list, else the settlement company's, else the one that orders use.
std::int64_t PriceList(DataApplication& application, Record& user, Record* settlement) {
    if (const auto own = LinkID(user, "Partner.IDGRPriceList")) return own;
    if (settlement != nullptr) {
        if (const auto theirs = LinkID(*settlement, "IDGRPriceList")) return theirs;
    }
    return application.DefaultLink("SDOrder", "GRPriceList");
}

CompanyState LoadCompany(DataApplication& application, const std::shared_ptr<Record>& user) {
    CompanyState company;
    company.PartnerRecord = user;
    const std::int64_t partner = LinkID(*user, "IDPartner");
    company.CompanyRecord = LoadLinked(application, "GRCompany", partner);
    company.CompanyLoaded = company.CompanyRecord != nullptr;
    if (company.CompanyLoaded) {
        company.CustomerKey = base::ToInteger32(static_cast<double>(partner));
        company.ParentRecord =
            LoadLinked(application, "GRCompany", LinkID(*company.CompanyRecord, "IDParent"));
        company.ParentLoaded = company.ParentRecord != nullptr;
    }
    company.PriceFactor = PriceFactor(*user);
    company.SettlementRecord =
        LoadLinked(application, "GRCompany", LinkID(*user, "Partner.IDSettlCompany"));
    company.PriceListId = base::ToInteger32(
        static_cast<double>(PriceList(application, *user, company.SettlementRecord.get())));
    company.IDContactPerson = LinkID(*user, "IDGRCompContPerson");
    company.ContactRecord = LoadLinked(application, "GRCompContPerson", company.IDContactPerson);
    company.ContactLoaded = company.ContactRecord != nullptr;
    return company;
}

void LogOn(SessionState& state, const Settings& settings, const Credentials& credentials) {
    auto application = state.services.make_application();
    // The guest's name here is this word, whatever the settings call him.
    application->Initialise("ZEBTell", "WEBUser", "WEBGuest", "Külaline");
    const auto user =
        application->Logon(settings.Type, settings.Path, credentials.user, credentials.password);
    state.company = LoadCompany(*application, user);
    state.logon.Application = std::move(application);
    state.logon.LoggedOn = true;
    state.logon.UserName = credentials.user;
    state.logon.Password = credentials.password;
}

std::string WaitMessage(const Settings& settings, std::chrono::seconds wait) {
    constexpr LocalText kBefore = {"Liiga palju ebaõnnestunud sisenemisi, proovige uuesti ",
                                   "Too many failed log-ons, try again after ",
                                   "Pārāk daudz neveiksmīgu pieteikšanās, mēģiniet vēlreiz pēc "};
    constexpr LocalText kAfter = {" sekundi pärast!", " seconds!", " sekundēm!"};
    const UserLanguage language = settings.language();
    return std::string(kBefore.In(language)) + std::to_string(wait.count()) +
           std::string(kAfter.In(language));
}

// Whether the password may be tried now. There is none to guess for a guest.
bool MayTry(SessionState& state,
            const web::Request& request,
            const Settings& settings,
            const Credentials& credentials) {
    if (state.logon.IsGuest) return true;
    const auto wait = state.services.logon_limits.Enter(credentials.user, request.remote_address);
    if (wait == std::chrono::seconds(0)) return true;
    state.Message = WaitMessage(settings, wait);
    WriteLog(state,
             "Log-on has to wait " + std::to_string(wait.count()) + " s (" +
                 request.remote_address + ")",
             log_Detail);
    return false;
}

// The database is not there, is busy or refuses the portal.
bool IsDatabaseProblem(const std::exception& error) {
    return base::AsRuntimeError(error).number() == base::errors::kUnspecified;
}

void GoOn(SessionState& state, web::Call& call) {
    const std::string page = std::exchange(state.logon.ReturnPage, {});
    call.RedirectTo(page.empty() ? "Raamistik" : std::string_view(page));
}

std::string LoggedInEntry(const web::Request& request, std::string_view user) {
    return base::WithoutControls(user) + " logged in (" + request.ServerVariables("REMOTE_HOST") +
           ";" + request.ServerVariables("REMOTE_ADDR") + ")";
}

}  // namespace

void Logon_Respond(SessionState& state, web::Call& call) {
    ShowPage(state, call);
}

void Logon_Logon(SessionState& state, web::Call& call) {
    const auto settings = state.settings();
    if (IsBlocked(state, *settings)) {
        state.Message = BlockedMessage(*settings);
        call.RedirectTo("Logon");
        return;
    }
    const Credentials credentials = ReadCredentials(state, call.request, *settings);
    if (state.logon.LoggedOn) {
        if (EqualNoCase(credentials.user, state.logon.UserName) &&
            EqualNoCase(credentials.password, state.logon.Password)) {
            // The form was sent twice: the browser may have dropped the first answer, and with it
            // the session's new token.
            call.RenewToken();
            GoOn(state, call);
            return;
        }
        ResetUserState(state);
    }
    if (!MayTry(state, call.request, *settings, credentials)) return call.RedirectTo("Logon");
    const auto refuse = [&](const std::exception& error) {
        if (IsDatabaseProblem(error)) {
            state.Message = kNotAvailable.In(settings->language());
        } else {
            CountFailure(state, *settings, credentials.user);
            state.Message = kInvalid.In(settings->language());
        }
        call.RedirectTo("Logon");
    };
    const auto enter = [&] {
        LogOn(state, *settings, credentials);
        if (!state.logon.IsGuest) {
            state.services.logon_limits.Succeeded(credentials.user, call.request.remote_address);
        }
        call.RenewToken();
        WriteLog(state, LoggedInEntry(call.request, credentials.user), log_Normal);
        GoOn(state, call);
    };
    Guarded(state, "Logon_Logon", enter, refuse);
}

void Logout_Respond(SessionState& state, web::Call& call) {
    WriteLog(state, base::WithoutControls(state.logon.UserName) + " logged out", log_Normal);
    ResetUserState(state);
    OrErrorPage(state, call, [&] { call.WriteTemplate(); });
    call.ReleaseInstance();
}

void Logout_Hyperlink2(SessionState&, web::Call& call) {
    call.NextItem("Logon");
}

}  // namespace zebtell::host
