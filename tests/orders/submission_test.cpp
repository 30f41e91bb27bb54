#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "orders/kinnitus.h"
#include "orders/saving_problem.h"
#include "tests/tags/session.h"

namespace zebtell::orders {
namespace {

constexpr std::string_view kFailed = "Probleem tellimuse salvestamisel!";

// A customer at the confirmation page: an order of one row, with ID 17 once it is stored.
class Submission : public ::testing::Test {
  protected:
    Submission() {
        session.runtime.url_for = [](std::string_view page, std::string_view) {
            return std::string(page);
        };
        session.runtime.write_template = [](web::Call& call) { call.response.Write("[page]"); };
        session.state.templates.OrdersAllowed = true;
        document->header->fields = {{"ID", 17}, {"Explanation", base::Value::Null()}};
        session.state.basket.Basket = document;
        session.state.basket.BasketRows = document->rows;
    }

    std::string Press(std::vector<web::Field> fields) {
        session.request.Form = web::FieldList(std::move(fields));
        session.response.Clear();
        Kinnitus_LisaTellimus(session.state, session.call);
        return session.response.redirect_address();
    }

    tags::Session session;
    std::shared_ptr<fake::Document> document = std::make_shared<fake::Document>();
};

TEST_F(Submission, AStoredOrderThatCannotBeReadAtOnceIsNotAFailure) {
    // Nothing can be read here: the database has no tables.
    session.state.documents.ShownOrder.Header = fake::MakeRecord({{"ID", 3}});
    EXPECT_EQ(Press({{"ZEB_But_Vormista", "1"}}), "Tellimus");
    EXPECT_EQ(document->saves, 1);
    EXPECT_EQ(session.state.Message, "");
    EXPECT_EQ(session.state.basket.Basket, nullptr);
    EXPECT_EQ(session.state.confirmation.ShownOrderFilter, "ID_17");
    EXPECT_EQ(session.state.documents.ShownOrder.Header, nullptr) << "not the order before it";
    EXPECT_EQ(Press({{"ZEB_But_Vormista", "1"}}), "Tellimus") << "a second click";
}

TEST_F(Submission, AFailedSaveKeepsTheBasketAndSaysWhy) {
    document->save_error = base::RuntimeError(base::errors::kInvalidCall, "The order has no rows");
    EXPECT_EQ(Press({{"ZEB_But_Vormista2", "1"}, {"ZEB_Komment", "tere"}}), "Kinnitus");
    EXPECT_EQ(session.state.Message,
              "Probleem tellimuse salvestamisel! Tellimusel ei ole ühtegi kogusega rida.");
    EXPECT_EQ(session.state.basket.Basket, document);
    EXPECT_EQ(document->header->fields.at("Explanation"), base::Value("tere"));
}

TEST_F(Submission, ButtonsInTheirOrder) {
    struct Case {
        const char* label;
        const char* button;
        const char* drop_to;
        const char* return_page;
        const char* address;
        bool keeps_basket;
    };
    const Case cases[] = {
        {"back", "ZEB_But_Tagasi", "", "", "Kaubainfo", true},
        {"store", "ZEB_But_Vormista", "", "", "Tellimus", false},
        {"store, short page", "ZEB_But_Vormista2", "", "", "Kinnitatud", false},
        {"drop", "ZEB_But_Kustuta", "", "", "Kaubainfo", false},
        {"drop, to the company", "ZEB_But_Kustuta", "firmainfo", "Other", "Firmainfo", false},
        {"drop, another page to return to", "ZEB_But_Kustuta", "", "Other", "", false},
        {"no known button", "x", "", "kaubainfo", "Kaubainfo", false},
        {"no known button, another page to return to", "x", "", "Other", "", false},
    };
    for (const Case& c : cases) {
        session.state.basket.Basket = document;
        session.state.basket.BasketRows = document->rows;
        session.state.basket_form.ReturnPage = c.return_page;
        EXPECT_EQ(Press({{c.button, "1"}, {"ZEB_Kustuta_Go", c.drop_to}}), c.address) << c.label;
        EXPECT_EQ(session.state.basket.Basket != nullptr, c.keeps_basket) << c.label;
    }
}

TEST_F(Submission, WhoMayNotOrderDoesNotStore) {
    session.state.templates.OrdersAllowed = false;
    EXPECT_EQ(Press({{"ZEB_But_Vormista", "1"}}), "Kinnitus");
    EXPECT_EQ(document->saves, 0);
    EXPECT_EQ(session.state.Message,
              "Tellimine ei ole lubatud, palun pöörduge oma müügiesindaja poole!");

    // No page was seen yet: the page's template is asked, and nothing of it is sent.
    session.state.templates.OrdersAllowed.reset();
    session.runtime.write_template = [this](web::Call& call) {
        session.state.templates.OrdersAllowed = false;
        call.response.Write("[page]");
    };
    EXPECT_EQ(Press({{"ZEB_But_Vormista", "1"}}), "Kinnitus");
    EXPECT_EQ(document->saves, 0);

    // Templates that never decide let everybody order.
    session.state.templates.OrdersAllowed.reset();
    session.runtime.write_template = [](web::Call&) {};
    EXPECT_EQ(Press({{"ZEB_But_Vormista", "1"}}), "Tellimus");
    EXPECT_EQ(document->saves, 1);
}

TEST(SavingProblem, SaysWhatTheUserCanDoSomethingAbout) {
    using Language = host::UserLanguage;
    struct Case {
        const char* description;
        Language language;
        const char* more;
    };
    const Case cases[] = {
        {"The wanted date is over", Language::kEstonian, " Soovitud tarnepäev on möödas."},
        {"The wanted date is over", Language::kEnglish, " The wanted delivery date is over."},
        {"Explanation is longer than 2000 characters",
         Language::kLatvian,
         " Piezīmes ir pārāk garas."},
        {"ExplanationOther is longer", Language::kEstonian, ""},
        {"database is locked", Language::kEstonian, ""},
        {"", Language::kEstonian, ""},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(DescribeSavingProblem(std::runtime_error(c.description), c.language).message,
                  std::string(kFailed) + c.more)
            << c.description;
    }
}

}  // namespace
}  // namespace zebtell::orders
