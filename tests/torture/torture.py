#!/usr/bin/env python3
"""Customers order while the portal is killed again and again; then every order is checked.

torture.py PROGRAM [--kills 100] [--seconds 60] [--customers 4] [--seed N]

A customer whose confirmation was not answered sends the same form again when the portal is back,
and is told whether his order was stored. In the end the database must hold the orders that were
answered, each once, with the sums that this script computes from what was ordered; none that was
refused; and no other.
"""

import argparse
import http.client
import itertools
import os
import random
import re
import resource
import signal
import sqlite3
import statistics
import subprocess
import sys
import tempfile
import threading
import time
import urllib.parse
from concurrent.futures import ThreadPoolExecutor
from decimal import ROUND_HALF_EVEN, ROUND_HALF_UP, Decimal
from pathlib import Path

CENT = Decimal("0.01")
STORED = ("Tellimus", "Kinnitatud")


class Gone(Exception):
    """The portal did not answer."""


class Portal:
    def __init__(self, program, folder):
        self.command = [program, "serve", "--folder", folder, "--port", "0"]
        self.errors = Path(folder, "errors")
        self.up = threading.Event()
        self.storing = threading.Event()  # a confirmation is on its way
        self.start_times = []

    def start(self):
        begin = time.monotonic()
        with open(self.errors, "a", encoding="utf-8") as errors:
            self.process = subprocess.Popen(self.command, stdout=subprocess.PIPE, stderr=errors,
                                            text=True)
        self.port = int(re.search(r":(\d+)/", self.process.stdout.readline()).group(1))
        connection = http.client.HTTPConnection("127.0.0.1", self.port, timeout=20)
        connection.request("GET", "/?page=Logon")
        assert connection.getresponse().status == 200
        self.start_times.append(time.monotonic() - begin)
        self.up.set()

    def stop(self, how=signal.SIGKILL):
        self.up.clear()
        self.storing.clear()
        self.process.send_signal(how)
        code = self.process.wait()
        self.process.stdout.close()
        assert code == (-how if how == signal.SIGKILL else 0), f"the portal ended with {code}"


class Order:
    """What a customer wants: quantities by price line."""
    numbers = itertools.count(1)

    def __init__(self, company, lines):
        self.company, self.lines, self.key = company, lines, None
        self.comment = f"order {next(self.numbers)} of the test"
        self.answer = None  # "stored" or "refused"


class Customer:
    def __init__(self, portal, user, password, company, assortment, rng):
        self.portal, self.user, self.password = portal, user, password
        self.company, self.assortment, self.rng = company, assortment, rng
        self.cookie, self.orders, self.unanswered = "", [], 0

    def ask(self, page, form=None):
        """Returns the page that a redirect leads to, or "", and the body."""
        try:
            connection = http.client.HTTPConnection("127.0.0.1", self.portal.port, timeout=30)
            headers = {"Cookie": self.cookie}
            if form is not None:
                headers["Content-Type"] = "application/x-www-form-urlencoded"
            connection.request("GET" if form is None else "POST", f"/?page={page}",
                               None if form is None else urllib.parse.urlencode(form), headers)
            response = connection.getresponse()
            body = response.read().decode()
            connection.close()
        except (OSError, http.client.HTTPException) as error:
            raise Gone from error
        assert response.status in (200, 303), f"{response.status} for {page}"
        self.cookie = (response.getheader("Set-Cookie") or self.cookie).split(";")[0]
        found = re.search(r"page=(\w+)", response.getheader("Location") or "")
        next_page = found.group(1) if found else ""
        if next_page == "Logon":
            raise Gone  # and came back, without the session
        return next_page, body

    def log_on(self):
        self.cookie = ""
        page, _ = self.ask("Logon&event=Logon", {"ZEB_IN_KASUTAJATUNNUS": self.user,
                                                 "ZEB_IN_PAROOL": self.password})
        assert page == "Raamistik", f"{self.user} can't log on: {page}"
        self.ask("Kaubainfo&event=Favorites")

    def fill_basket(self):
        lines = self.rng.sample(self.assortment, self.rng.randint(1, 12))
        quantities = [Decimal(self.rng.choice((1, 2, 7, 12, 1000))) / self.rng.choice((1, 1, 8))
                      for _ in lines]
        order = Order(self.company, dict(zip(lines, quantities)))
        self.ask("Kaubainfo&event=Lisamine",
                 {f"ID_{line}": str(quantity) for line, quantity in order.lines.items()})
        order.key = re.search(r'name="ZEB_DocKey" value="(\w{32})"', self.ask("Kinnitus")[1])[1]
        self.orders.append(order)
        return order

    def confirm(self, order):
        return self.ask("Kinnitus&event=LisaTellimus",
                        {"ZEB_But_Vormista": "1", "ZEB_DocKey": order.key,
                         "ZEB_Komment": order.comment})[0]

    def clicks(self, order):
        """The answers to one click, or to two at the same time."""
        def click(_):
            try:
                self.portal.storing.set()
                return self.confirm(order)
            except Gone:
                return None
        with ThreadPoolExecutor() as threads:
            return list(threads.map(click, range(1 + (self.rng.random() < 0.3))))

    def settle(self, order):
        """Confirms until the customer knows where he is."""
        answers = self.clicks(order)
        end = time.monotonic() + 60
        while not any(answers):
            assert time.monotonic() < end, f"no answer for {self.user} for a minute"
            self.unanswered += 1
            self.portal.up.wait(30)
            try:
                self.log_on()
                answers = [self.confirm(order)]
            except Gone:
                pass
        known = [answer for answer in answers if answer]
        order.answer = "stored" if known[0] in STORED else "refused"
        assert all((answer in STORED) == (order.answer == "stored") for answer in known), answers
        if order.answer == "refused":
            assert "ei salvestatud" in self.ask("Kaubainfo")[1], "not told that nothing was stored"

    def shop(self, closing):
        while not closing.is_set():
            try:
                if not self.cookie:
                    self.log_on()
                order = self.fill_basket()
                self.settle(order)
                if self.rng.random() < 0.2 and order.answer == "stored":
                    assert self.confirm(order) in STORED, "a form sent again"
            except Gone:
                self.cookie = ""
                self.portal.up.wait(30)


def read(database, sql, *values):
    with sqlite3.connect(database, timeout=20) as connection:
        return connection.execute(sql, values).fetchall()


def find_customers(database, portal, count, rng):
    rows = read(database, """
        SELECT u.Name, c.ID FROM SYUser u JOIN GRCompany c ON c.ID = u.IDPartner
        WHERE u.Name LIKE 'klient%' AND c.OrdersAllowed = 1 AND c.IDGRPriceList IS NOT NULL""")
    for user, company in rng.sample(rows, count):
        lines = read(database, """
            SELECT p.ID FROM SQPriceList5 p JOIN GRCompany c ON c.IDGRPriceList = p.IDGRPriceList
            WHERE c.ID = ? AND p.Price > 0""", company)
        yield Customer(portal, user, "klient-demo", company, [line for line, in lines],
                       random.Random(rng.random()))


def expected(database, order):
    """The order's rows and tax lines, from the price lists."""
    rows, bases = set(), {}
    for line, quantity in order.lines.items():
        (article, price, cut, tax), = read(database, """
            SELECT p.IDGRArticle, p.Price, r.PriceCut, t.TaxPercent FROM GRCompany c
            JOIN SQPriceList5 p ON p.IDGRPriceList = c.IDGRPriceList
            JOIN GRArticle a ON a.ID = p.IDGRArticle JOIN GRTax t ON t.ID = a.IDGRTax
            LEFT JOIN GRPriceCatRel r ON r.IDGRCompanyPriceCat = c.IDGRCompanyPriceCat
                AND r.IDGRArticlePriceCat = a.IDGRArticlePriceCat
                AND r.IDGRPriceList = p.IDSrcPriceList
            WHERE c.ID = ? AND p.ID = ?""", order.company, line)
        price = (Decimal(str(price)) * (100 + Decimal(str(cut or 0))) / 100).quantize(
            CENT, ROUND_HALF_UP)
        amount = (price * quantity).quantize(CENT, ROUND_HALF_EVEN)
        rows.add((article, quantity, price, amount, Decimal(str(tax))))
        bases[tax] = bases.get(tax, 0) + amount
    taxes = {(Decimal(str(tax)), base,
              (base * Decimal(str(tax)) / 100).quantize(CENT, ROUND_HALF_EVEN))
             for tax, base in bases.items()}
    return rows, taxes


def money(values):
    return tuple(Decimal(str(value)).quantize(Decimal("0.0001")) for value in values)


def check(database, orders, before):
    for order in orders:
        stored = read(database, """
            SELECT o.ID, o.Amount, o.TaxAmount, o.AmountWTax FROM SDOrder o
            JOIN GDocument d ON d.ID = o.ID
            WHERE d.DocKey = ? AND o.IDGRCompany = ? AND o.Explanation = ?""",
                      order.key, order.company, order.comment)
        assert len(stored) == (order.answer == "stored"), f"{order.answer}, but {stored}"
        if not stored:
            continue
        order_id, *sums = stored[0]
        rows, taxes = expected(database, order)
        assert {money(row) for row in rows} == {money(row) for row in read(
            database, "SELECT IDGRArticle, Quantity, Price, Amount, TaxPercent FROM SDOrderRow "
            "WHERE IDSDOrder = ?", order_id)}, f"rows of {order_id}"
        assert {money(row) for row in taxes} == {money(row) for row in read(
            database, "SELECT TaxPercent, Base, Amount FROM GDTax WHERE IDGDocument = ?",
            order_id)}, f"taxes of {order_id}"
        amount, tax = sum(row[3] for row in rows), sum(row[2] for row in taxes)
        assert money(sums) == money((amount, tax, amount + tax)), f"sums of {order_id}"
    stored = sum(order.answer == "stored" for order in orders)
    (count, most), = read(database, "SELECT count(*), max(Number) FROM SDOrder")
    assert (count, most) == (before[0] + stored, before[1] + stored), "orders that nobody sent"
    assert read(database, "SELECT count(*) FROM GDocument")[0][0] == before[2] + stored
    assert read(database, "PRAGMA integrity_check") == [("ok",)]
    assert read(database, "PRAGMA foreign_key_check") == []


def kill_under_load(portal, customers, kills, seconds, rng):
    closing, end = threading.Event(), time.monotonic() + seconds
    with ThreadPoolExecutor() as threads:
        shops = [threads.submit(customer.shop, closing) for customer in customers]
        done = 0
        while done < kills and time.monotonic() < end and not any(s.done() for s in shops):
            # Three of four while orders are being stored, the others at any time.
            if rng.random() < 0.75:
                portal.storing.wait(3)
                time.sleep(rng.uniform(0, 0.06))
            else:
                time.sleep(rng.uniform(0.01, 0.4))
            portal.stop()
            portal.start()
            done += 1
        closing.set()
        for shop in shops:
            shop.result()
    return done


def refused_then_stored(customer, hinder, release):
    """An order that can't be stored for a while: the customer is told and keeps his basket."""
    customer.log_on()
    order = customer.fill_basket()
    hinder()
    assert customer.confirm(order) == "Kinnitus"
    page = customer.ask("Kinnitus")[1]
    assert "Probleem tellimuse salvestamisel!" in page and order.key in page, "told and kept"
    release()
    assert customer.confirm(order) == "Tellimus"
    order.answer = "stored"


def lock_database(database, customer):
    other = sqlite3.connect(database, isolation_level=None)
    refused_then_stored(customer, lambda: other.execute("BEGIN IMMEDIATE"),
                        lambda: other.execute("ROLLBACK"))
    other.close()


def fill_disk(portal, customer):
    """No file may grow, as on a disk without room."""
    def limit(size):
        hard = resource.prlimit(portal.process.pid, resource.RLIMIT_FSIZE)[1]
        resource.prlimit(portal.process.pid, resource.RLIMIT_FSIZE, (size, hard))
    refused_then_stored(customer, lambda: limit(1), lambda: limit(resource.RLIM_INFINITY))


def leave_long_log(database, megabytes):
    """Leaves a write-ahead log of committed rows, as a process that was killed does."""
    child = os.fork()
    if child == 0:
        connection = sqlite3.connect(database, timeout=20)
        connection.execute("PRAGMA wal_autocheckpoint = 0")
        for _ in range(megabytes):
            connection.execute("UPDATE GRTax SET Name = Name")
            connection.execute("CREATE TABLE Filler AS SELECT zeroblob(1000000) AS x")
            connection.execute("DROP TABLE Filler")
            connection.commit()
        os.kill(os.getpid(), signal.SIGKILL)
    os.waitpid(child, 0)
    return os.path.getsize(database + "-wal") / 1e6


def main():
    options = argparse.ArgumentParser(usage=__doc__)
    options.add_argument("program")
    options.add_argument("--kills", type=int, default=100)
    options.add_argument("--seconds", type=float, default=60)
    options.add_argument("--customers", type=int, default=4)
    options.add_argument("--seed", type=int, default=random.randrange(10**6))
    options = options.parse_args()
    print(f"torture: seed {options.seed}", flush=True)
    rng = random.Random(options.seed)
    with tempfile.TemporaryDirectory() as folder:
        subprocess.run([options.program, "demo", "--folder", folder], check=True,
                       stdout=subprocess.DEVNULL)
        database = str(Path(folder, "company.db"))
        before = read(database, "SELECT count(*), max(Number), (SELECT count(*) FROM GDocument) "
                      "FROM SDOrder")[0]
        portal = Portal(options.program, folder)
        portal.start()
        customers = list(find_customers(database, portal, options.customers, rng))
        kills = kill_under_load(portal, customers, options.kills, options.seconds, rng)
        lock_database(database, customers[0])
        fill_disk(portal, customers[0])
        portal.stop()
        log_size = leave_long_log(database, 40)
        portal.start()
        customers[0].log_on()
        portal.stop(signal.SIGTERM)

        orders = [order for customer in customers for order in customer.orders]
        check(database, orders, before)
        stored = sum(order.answer == "stored" for order in orders)
        unanswered = sum(customer.unanswered for customer in customers)
        times = portal.start_times
        print(f"torture: {kills} kills, {stored} orders stored, {len(orders) - stored} refused, "
              f"{unanswered} confirmations without an answer; restart "
              f"{statistics.median(times):.3f} s, at most {max(times):.3f} s, "
              f"{times[-1]:.3f} s with a write-ahead log of {log_size:.0f} MB")
        print("".join(sorted(set(open(portal.errors, encoding="utf-8")))), end="")
        assert kills >= options.kills / 2 and unanswered > 0, "the test has not tested much"
        assert statistics.median(times) < 1 and times[-1] < 1, "the restart takes too long"


if __name__ == "__main__":
    sys.exit(main())
