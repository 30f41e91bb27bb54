-- For the login that "zebtell user" works with, besides grants.sql. Without these rights log-ons are
-- administered elsewhere.

GRANT INSERT ON SYUser TO zebtell;
GRANT UPDATE ON SYUser TO zebtell;
