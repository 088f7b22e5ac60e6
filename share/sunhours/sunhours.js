"use strict";
(() => {
    const data = JSON.parse(document.getElementById("data").textContent);
    const element = id => document.getElementById(id);
    const pixels = data.width * data.height;
    const tenths = new Intl.NumberFormat(document.documentElement.lang, { minimumFractionDigits: 1, maximumFractionDigits: 1 });
    const inHours = number => data.hour.replace("%1", number);

    // Runs of equal numbers: the change of the number, by turns up and down, and how long it stays.
    const expand = (text, into) => {
        const bytes = atob(text);
        let at = 0;
        const next = () => {
            let number = 0;
            for (let scale = 1; ; scale *= 128) {
                const byte = bytes.charCodeAt(at++);
                number += (byte & 127) * scale;
                if (byte < 128) return number;
            }
        };
        for (let place = 0, value = 0; at < bytes.length;) {
            const step = next();
            value += step % 2 ? -(step + 1) / 2 : step / 2;
            const end = place + next();
            into.fill(value, place, end);
            place = end;
        }
        return into;
    };

    const hours = expand(data.hours, new Int16Array(pixels));
    const objects = expand(data.objects, new Int32Array(pixels));
    let before = new Uint8Array(pixels);
    const lit = data.lit.map(text => {
        const now = expand(text, new Uint8Array(pixels));
        for (let i = 0; i < pixels; ++i) now[i] ^= before[i];
        return before = now;
    });

    const shadow = element("shadow");
    shadow.width = data.width;
    shadow.height = data.height;
    const paint = shadow.getContext("2d");
    const shades = paint.createImageData(data.width, data.height);

    const showStep = step => {
        const now = lit[step];
        for (let i = 0; i < pixels; ++i)
            shades.data[4 * i + 3] = hours[i] < 0 || now[i] ? 0 : 140;
        paint.putImageData(shades, 0, 0);
        element("clock").textContent = data.times[step];
        element("slider").setAttribute("aria-valuetext", data.times[step]);
    };

    const strip = element("strip");
    const showStrip = pixel => {
        strip.width = lit.length;
        strip.height = 1;
        const line = strip.getContext("2d");
        lit.forEach((now, step) => {
            line.fillStyle = pixel >= 0 && now[pixel] ? "#f5b301" : "#e8e9eb";
            line.fillRect(step, 0, 1, 1);
        });
    };

    const read = event => {
        const box = element("picture").getBoundingClientRect();
        const x = Math.floor((event.clientX - box.left) / box.width * data.width);
        const y = Math.floor((event.clientY - box.top) / box.height * data.height);
        const isInside = x >= 0 && y >= 0 && x < data.width && y < data.height;
        const pixel = isInside && hours[y * data.width + x] >= 0 ? y * data.width + x : -1;
        element("reading").textContent = pixel < 0 ? "\u00a0"
            : inHours(tenths.format(hours[pixel] / 100)) + " · " + data.names[objects[pixel] - 1];
        if (lit.length) showStrip(pixel);
    };

    element("colors").style.background = "linear-gradient(to right, " + data.scale.join(", ") + ")";
    const every = Math.ceil(data.end / 12);
    for (let hour = 0; hour <= data.end; hour += every) {
        const tick = document.createElement("span");
        tick.style.left = 100 * hour / data.end + "%";
        tick.textContent = hour ? inHours(hour) : hour;
        element("ticks").append(tick);
    }
    element("stage").addEventListener("pointermove", read);
    element("stage").addEventListener("pointerdown", read);
    if (lit.length) {
        const slider = element("slider");
        slider.max = lit.length - 1;
        slider.value = lit.length >> 1;
        slider.addEventListener("input", () => showStep(slider.valueAsNumber));
        element("clock").textContent = data.move;
        element("day").hidden = false;
        showStrip(-1);
    }
})();
