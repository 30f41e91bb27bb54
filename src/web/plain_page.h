#pragma once

#include "http/message.h"

namespace zebtell::web {

// A small page for a request that no page of the site answers, with what every page's headers say.
// It tells the person what to do, and nothing about the inside.
http::Response PlainPage(int status);

// The page's HTML alone.
std::string PlainPageHtml(int status);

}  // namespace zebtell::web
