#include <CLI/CLI.hpp>
#include <functional>
#include <iostream>
#include <optional>

#include "app/commands.h"
#include "app/page_vocabulary.h"
#include "base/runtime_error.h"

namespace {

namespace fs = std::filesystem;
using namespace zebtell;

fs::path ProgramFolder() {
    std::error_code unknown;
    const fs::path program = fs::read_symlink("/proc/self/exe", unknown);
    return unknown ? fs::current_path() : program.parent_path();
}

// Where the build and the installation put the templates that come with the program.
fs::path DefaultTemplates() {
    return ProgramFolder().parent_path() / "share/zebtell/templates";
}

struct ServeFlags {
    std::optional<std::string> address;
    std::optional<int> port;
    std::optional<int> threads;
    std::optional<std::string> templates;

    void Apply(host::ServerSettings& settings) const {
        if (address) settings.Address = *address;
        if (port) settings.Port = *port;
        if (threads) settings.Threads = *threads;
        if (templates) settings.TemplateFolder = *templates;
        settings.DefaultTemplates = DefaultTemplates();
    }
};

struct Flags {
    std::string folder = ProgramFolder().string();
    ServeFlags serve;
    demo::DemoOptions demo;
    std::string check_templates;
    std::string text_templates;
    erp::UserAdmin::NewUser user;
};

// What the command line asks for, run when all of it has been read.
using Command = std::function<int()>;

CLI::App* AddCommand(
    CLI::App& app, const char* name, const char* help, Flags& flags, Command& chosen, Command run) {
    CLI::App* command = app.add_subcommand(name, help);
    command->add_option("--folder", flags.folder, "folder of ZEBTell.ini (the program's own)");
    command->callback([&chosen, run = std::move(run)] { chosen = run; });
    return command;
}

int RunServe(Flags& flags) {
    // The program works in the settings' folder; the flag counts from where it was typed.
    if (flags.serve.templates) {
        flags.serve.templates = fs::absolute(*flags.serve.templates).string();
    }
    return app::Serve(flags.folder, [&](host::ServerSettings& s) { flags.serve.Apply(s); });
}

void AddServe(CLI::App& app, Flags& flags, Command& chosen) {
    CLI::App* serve = AddCommand(
        app, "serve", "serve the portal until it is told to stop", flags, chosen, [&flags] {
            return RunServe(flags);
        });
    serve->add_option("--address", flags.serve.address, "address to listen on");
    serve->add_option("--port", flags.serve.port, "port to listen on; 0: any free one")
        ->check(CLI::Range(0, 65535));
    serve->add_option("--threads", flags.serve.threads, "worker threads")
        ->check(CLI::Range(0, 256));
    serve->add_option("--templates",
                      flags.serve.templates,
                      "folder of own templates, in place of the settings' one");
}

void AddCheck(CLI::App& app, Flags& flags, Command& chosen) {
    CLI::App* check = AddCommand(
        app,
        "check",
        "find what is wrong with settings, database and templates",
        flags,
        chosen,
        [&] { return app::Check(flags.folder, flags.check_templates, DefaultTemplates()); });
    check->add_option("--templates",
                      flags.check_templates,
                      "folder of own templates, in place of the settings' one");
}

void AddDemo(CLI::App& app, Flags& flags, Command& chosen) {
    CLI::App* demo = AddCommand(
        app, "demo", "make the demo company, unless it is there", flags, chosen, [&flags] {
            return app::MakeDemo(flags.folder, flags.demo);
        });
    demo->add_option("--articles", flags.demo.articles, "articles (3000)");
    demo->add_option("--companies", flags.demo.companies, "customers (40)");
    demo->add_option("--order-rows", flags.demo.order_rows, "rows of all orders (15000)");
}

void AddUserCommands(CLI::App& app, Flags& flags, Command& chosen) {
    CLI::App* user = app.add_subcommand("user", "who may log on");
    user->require_subcommand(1);
    const auto command = [&](const char* name, const char* help, Command run) {
        return AddCommand(*user, name, help, flags, chosen, std::move(run));
    };
    const auto named = [&](const char* name, const char* help, Command run) {
        CLI::App* added = command(name, help, std::move(run));
        added->add_option("name", flags.user.name, "the user's name")->required();
        return added;
    };
    CLI::App* add = named("add", "add a user; the password is asked for", [&flags] {
        return app::AddUser(flags.folder, flags.user);
    });
    add->add_option("--partner", flags.user.partner_code, "code of the user's company");
    add->add_option("--display-name", flags.user.display_name, "name for people");
    add->add_flag("--guest", flags.user.guest, "whom visitors without a name log on as");
    named("password", "change a password, which is asked for", [&flags] {
        return app::SetUserPassword(flags.folder, flags.user.name);
    });
    named("disable", "let a user log on no more", [&flags] {
        return app::SetUserDisabled(flags.folder, flags.user.name, true);
    });
    named("enable", "let a disabled user log on again", [&flags] {
        return app::SetUserDisabled(flags.folder, flags.user.name, false);
    });
    command("list", "name, kind, name for people, company", [&flags] {
        return app::ListUsers(flags.folder);
    });
}

void AddTags(CLI::App& app, Command& chosen) {
    app.add_subcommand("tags", "print the tags that templates can use")->callback([&chosen] {
        chosen = [] {
            app::PrintTags(std::cout);
            return 0;
        };
    });
}

void AddTexts(CLI::App& app, Flags& flags, Command& chosen) {
    CLI::App* texts = app.add_subcommand("texts", "print the texts of templates to be translated");
    texts->add_option("templates", flags.text_templates, "their folder")->required();
    texts->callback([&] { chosen = [&] { return app::PrintTexts(flags.text_templates); }; });
}

int Run(int argc, char** argv) {
    CLI::App app{"ZEBTell, the web ordering portal"};
    app.require_subcommand(1);
    Flags flags;
    Command chosen;
    AddServe(app, flags, chosen);
    AddCheck(app, flags, chosen);
    AddDemo(app, flags, chosen);
    AddUserCommands(app, flags, chosen);
    AddTags(app, chosen);
    AddTexts(app, flags, chosen);
    CLI11_PARSE(app, argc, argv);
    return chosen();
}

}  // namespace

int main(int argc, char** argv) {
    try {
        return Run(argc, argv);
    } catch (const std::exception& error) {
        std::cerr << "zebtell: " << error.what() << "\n";
        return 1;
    }
}
