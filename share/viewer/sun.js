// Where the sun of a study stands: a compass with the zenith in its middle, and the time.

const HORIZON = 44; // radius in the dial

class Sun {
    constructor(suns, place) {
        this.suns = suns; // [time, zone, azimuth, altitude] of each frame, or null
        element('sun').hidden = false;
        element('sun-site').textContent = place;
        element('sun-way').setAttribute('d', this.way());
    }

    // Of the sun's places while it is up.
    way() {
        let text = '';
        let isDown = true;
        for (const sun of this.suns) {
            if (!sun || sun[3] < 0) {
                isDown = true;
                continue;
            }
            const [x, y] = placeInDial(sun[2], sun[3]);
            text += `${isDown ? 'M' : 'L'}${x.toFixed(2)} ${y.toFixed(2)}`;
            isDown = false;
        }
        return text;
    }

    show(frame) {
        const sun = this.suns[frame];
        if (!sun) return;
        const [time, zone, azimuth, altitude] = sun;
        element('sun-date').textContent = dateText(time);
        element('sun-time').textContent = clockText(time);
        element('sun-zone').textContent = zone;
        element('sun-angles').textContent = `${say('azimuth', Math.round(azimuth))}\n${altitudeText(altitude)}`;
        element('sun').classList.toggle('night', altitude < 0);
        const [x, y] = placeInDial(azimuth, altitude);
        for (const [name, value] of [['x2', x], ['y2', y]]) element('sun-ray').setAttribute(name, value);
        for (const [name, value] of [['cx', x], ['cy', y]]) element('sun-place').setAttribute(name, value);
        element('dial').setAttribute('aria-label', `${say('sun')}: ${say('azimuth', Math.round(azimuth))}, ${altitudeText(altitude)}`);
    }

    // What a slider at this frame says.
    spoken(frame) {
        const sun = this.suns[frame];
        return sun ? `${dateText(sun[0])}, ${clockText(sun[0])} ${sun[1]}` : null;
    }
}

// North is up; a sun below the horizon stands on its circle.
function placeInDial(azimuth, altitude) {
    const radius = HORIZON * (1 - Math.max(altitude, 0) / 90);
    const angle = azimuth * Math.PI / 180;
    return [radius * Math.sin(angle), -radius * Math.cos(angle)];
}

function altitudeText(altitude) {
    const degrees = Math.round(altitude);
    return degrees >= 0 ? say('above_horizon', degrees) : say('below_horizon', -degrees);
}

// Times are those of the place, whatever zone the reader is in.
function formatted(time, parts) {
    return new Intl.DateTimeFormat(LANGUAGE, { ...parts, timeZone: 'UTC' }).format(new Date(`${time}Z`));
}

function dateText(time) { return formatted(time, { dateStyle: 'long' }); }
function clockText(time) { return time.slice(11, 16); }
