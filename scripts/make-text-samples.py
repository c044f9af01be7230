#!/usr/bin/env python3
"""Writes the text-format samples (XML, CSV types 1 and 2, KEL, APRS) from our own points."""
import os

HERE = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "resources", "Samples")
CRLF = "\r\n"


def write(name, lines):
    with open(os.path.join(HERE, name), "w", newline="") as f:
        f.write(CRLF.join(lines) + CRLF)


def ddmm(value, latitude):
    a = abs(float(value))
    d = int(a)
    m = (a - d) * 60
    text = f"{d:02d}{m:05.2f}" if latitude else f"{d:03d}{m:05.2f}"
    if latitude:
        return text + ("N" if float(value) >= 0 else "S")
    return text + ("E" if float(value) >= 0 else "W")


def main():
    with open(os.path.join(HERE, "source-points.csv")) as f:
        points = [line.strip().split(",") for line in f.readlines()[1:] if line.strip()]

    xml = ['<?xml version="1.0" encoding="UTF-8"?>', "<tracks>", "<track>"]
    for lat, lon, alt, d, t, name, *_ in points:
        xml += ["<trackpoint>", f"<latitude>{lat}</latitude>", f"<longitude>{lon}</longitude>",
                f"<altitude>{alt}</altitude>", f'<time>{d.replace("/", "-")}T{t}Z</time>', f"<name>{name}</name>",
                "</trackpoint>"]
    write("sample.xml", xml + ["</track>", "</tracks>"])

    orion = ["Index,Timestamp,Unit,Event,Status,Longitude,Latitude,Band,Speed"]
    csv2 = ["No,Date,Time,Latitude,Longitude,Altitude,Status,Speed"]
    kel = ["Date\tTime\tLatitude\tLongitude\tSpeed\tHeading\tNote"]
    aprs = ["VE3XYZ*"]
    for i, (lat, lon, alt, d, t, name, *_) in enumerate(points, 1):
        day = d.replace("/", "-")
        status = "MOTION DETECTED" if i == 1 else "MOVING"
        orion.append(f"{i},{day} {t}.000,ORION1,POS,{status},{lon},{lat},{i % 10},{10 + i * 2}")
        csv2.append(f"{i},{day},{t},{lat},{lon},{alt},Moving,{10 + i * 2}mph")
        kel.append(f"{day}\t{t}\t{lat}\t{lon}\t{10 + i * 2}\t45\tWaypoint {name} on the river path")
        feet = round(float(alt) * 3.28083)
        packet = f"VE3XYZ-9>APRS,WIDE2-2:!{ddmm(lat, True)}/{ddmm(lon, False)}>/A={feet:06d}"
        # Short reports alone on their line; long ones as a log writes them, the time in front.
        aprs.append(packet if i % 2 else
                    f"{day} {t} {packet} Ottawa river path, mobile station, 13.8V, beacon every 60 s")
    write("sample-orion.csv", orion)
    write("sample-csv2.csv", csv2)
    write("sample-kel.txt", kel)
    write("sample-aprs.txt", aprs)


if __name__ == "__main__":
    main()
