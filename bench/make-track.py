#!/usr/bin/env python3
"""Writes a large, realistic track (seeded): several days of driving with stops and segment breaks,
as GPX 1.0, NMEA sentences or OziExplorer PLT.

usage: make-track.py FORMAT POINTS OUT   (FORMAT: gpx, nmea, plt)
"""
import math
import random
import sys
from datetime import datetime, timedelta, timezone

EPOCH_OZI = datetime(1899, 12, 30, tzinfo=timezone.utc)


def points(count, seed=20261206):
    rnd = random.Random(seed)
    lat, lon, alt = 45.4215, -75.6972, 70.0
    heading = rnd.uniform(0, 360)
    t = datetime(2007, 3, 14, 8, 0, 0, tzinfo=timezone.utc)
    segment_start = True
    for i in range(count):
        # A new day every 40,000 points, a stop now and then, a lost fix (segment break) rarely.
        if i and i % 40000 == 0:
            t += timedelta(hours=14)
            segment_start = True
        stopped = (i // 500) % 17 == 0
        speed = 0.0 if stopped else max(0.0, rnd.gauss(60, 15))  # km/h
        heading = (heading + rnd.gauss(0, 8)) % 360
        step = speed / 3600.0  # km in one second
        lat += step / 111.195 * math.cos(math.radians(heading))
        lon += step / (111.195 * math.cos(math.radians(lat))) * math.sin(math.radians(heading))
        alt = max(0.0, alt + rnd.gauss(0, 0.8))
        if rnd.random() < 0.0005:
            t += timedelta(seconds=rnd.randint(60, 900))
            segment_start = True
        yield lat, lon, alt, t, speed, segment_start
        segment_start = False
        t += timedelta(seconds=1)


def nmea_checksum(body):
    c = 0
    for ch in body:
        c ^= ord(ch)
    return f"{c:02X}"


def ddmm(value, lat):
    a = abs(value)
    d = int(a)
    m = (a - d) * 60
    text = f"{d:02d}{m:07.4f}" if lat else f"{d:03d}{m:07.4f}"
    return text, ("N" if value >= 0 else "S") if lat else ("E" if value >= 0 else "W")


def write_gpx(out, count):
    out.write('<?xml version="1.0" encoding="UTF-8"?>\n<gpx version="1.0" creator="bench" '
              'xmlns="http://www.topografix.com/GPX/1/0">\n<trk>\n<name>bench</name>\n')
    first = True
    for lat, lon, alt, t, _, start in points(count):
        if start:
            if not first:
                out.write("</trkseg>\n")
            out.write("<trkseg>\n")
            first = False
        out.write(f'<trkpt lat="{lat:.6f}" lon="{lon:.6f}">\n  <ele>{alt:.1f}</ele>\n'
                  f'  <time>{t.strftime("%Y-%m-%dT%H:%M:%SZ")}</time>\n</trkpt>\n')
    out.write("</trkseg>\n</trk>\n</gpx>\n")


def write_nmea(out, count):
    for lat, lon, alt, t, speed, _ in points(count):
        la, ns = ddmm(lat, True)
        lo, ew = ddmm(lon, False)
        hms = t.strftime("%H%M%S")
        body = f"GPRMC,{hms},A,{la},{ns},{lo},{ew},{speed / 1.852:.1f},0.0,{t.strftime('%d%m%y')},,"
        out.write(f"${body}*{nmea_checksum(body)}\r\n")


def write_plt(out, count):
    out.write("OziExplorer Track Point File Version 2.1\r\nWGS 84\r\nAltitude is in Feet\r\nReserved 3\r\n"
              f"0,2,255,bench,0,0,2,8421376\r\n{count}\r\n")
    for lat, lon, alt, t, _, start in points(count):
        day = (t - EPOCH_OZI).total_seconds() / 86400
        out.write(f"{lat:.6f},{lon:.6f},{1 if start else 0},{alt * 3.28083:.1f},{day:.7f},"
                  f"{t.strftime('%d-%b-%y')},{t.strftime('%H:%M:%S')}\r\n")


def main():
    fmt, count, path = sys.argv[1], int(sys.argv[2]), sys.argv[3]
    writer = {"gpx": write_gpx, "nmea": write_nmea, "plt": write_plt}[fmt]
    with open(path, "w", newline="", buffering=1 << 20) as out:
        writer(out, count)


if __name__ == "__main__":
    main()
