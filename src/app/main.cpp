#include <CLI/CLI.hpp>
#include <iostream>
#include <optional>

#include "app/commands.h"
#include "base/runtime_error.h"

namespace {

namespace fs = std::filesystem;
using namespace zebtell;

fs::path ProgramFolder() {
    std::error_code unknown;
    const fs::path program = fs::read_symlink("/proc/self/exe", unknown);
    return unknown ? fs::current_path() : program.parent_path();
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
    }
};

struct Flags {
    std::string folder = ProgramFolder().string();
    ServeFlags serve;
    std::string demo_templates = (ProgramFolder() / "templates").string();
    demo::DemoOptions demo;
};

void AddFolder(CLI::App* command, Flags& flags) {
    command->add_option("--folder", flags.folder, "folder of ZEBTell.ini (the program's own)");
}

CLI::App* AddServe(CLI::App& app, Flags& flags) {
    CLI::App* serve = app.add_subcommand("serve", "serve the portal until it is told to stop");
    AddFolder(serve, flags);
    serve->add_option("--address", flags.serve.address, "address to listen on");
    serve->add_option("--port", flags.serve.port, "port to listen on; 0: any free one")
        ->check(CLI::Range(0, 65535));
    serve->add_option("--threads", flags.serve.threads, "worker threads")
        ->check(CLI::Range(0, 256));
    serve->add_option("--templates", flags.serve.templates, "folder of the templates");
    return serve;
}

CLI::App* AddDemo(CLI::App& app, Flags& flags) {
    CLI::App* demo = app.add_subcommand("demo", "make the demo company, unless it is there");
    AddFolder(demo, flags);
    demo->add_option("--templates", flags.demo_templates, "folder of the templates");
    demo->add_option("--articles", flags.demo.articles, "articles (3000)");
    demo->add_option("--companies", flags.demo.companies, "customers (40)");
    demo->add_option("--order-rows", flags.demo.order_rows, "rows of all orders (15000)");
    return demo;
}

int Run(int argc, char** argv) {
    CLI::App app{"ZEBTell, the web ordering portal"};
    app.require_subcommand(1);
    Flags flags;
    const CLI::App* serve = AddServe(app, flags);
    AddDemo(app, flags);
    CLI11_PARSE(app, argc, argv);

    if (serve->parsed()) {
        // The program works in the settings' folder; the flag counts from where it was typed.
        if (flags.serve.templates) {
            flags.serve.templates = fs::absolute(*flags.serve.templates).string();
        }
        return app::Serve(flags.folder, [&](host::ServerSettings& s) { flags.serve.Apply(s); });
    }
    return app::MakeDemo(flags.folder, flags.demo_templates, flags.demo);
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
