-- What the wrk scripts share: every thread works with its own part of the sessions in the file
-- that SESSIONS names.
local sessions = {}

local thread_count = 0

function sessions.number_threads(thread)
    thread:set("thread_number", thread_count)
    thread_count = thread_count + 1
end

function sessions.mine(thread_number, threads)
    local cookies, line_number = {}, 0
    for line in io.lines(os.getenv("SESSIONS")) do
        if line_number % threads == thread_number then cookies[#cookies + 1] = line end
        line_number = line_number + 1
    end
    return cookies
end

function sessions.post(page, cookie, body)
    return wrk.format("POST", "/?page=" .. page, {
        ["Cookie"] = cookie,
        ["Content-Type"] = "application/x-www-form-urlencoded",
    }, body)
end

function sessions.get(page, cookie)
    return wrk.format("GET", "/?page=" .. page, {["Cookie"] = cookie})
end

return sessions
