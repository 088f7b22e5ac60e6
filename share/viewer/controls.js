// Buttons, slider and the sheet with the line to embed.

const RATES = [5, 10, 12, 15, 20, 24, 25, 30, 60];

class Controls {
    constructor(viewer) {
        this.viewer = viewer;
        this.isTurntable = viewer.recording.kind === 'turntable';
        this.slider = element('slider');
        this.nameAll();
        this.fillRates();
        this.listen();
        this.prepareSlider();
        prepareSheet(viewer.recording);
    }

    nameAll() {
        label(element('fit'), say('fit'));
        label(element('loop'), say('loop'));
        label(element('rate'), say('rate'));
        label(element('more'), say('embed'));
        label(element('ring'), say('loading'));
        element('controls').setAttribute('aria-label', say('controls'));
        element('full').hidden = !document.fullscreenEnabled;
        this.nameFullScreen();
    }

    nameFullScreen() {
        label(element('full'), say(document.fullscreenElement ? 'leave_full_screen' : 'full_screen'));
    }

    fillRates() {
        const rates = [...new Set([...RATES, this.viewer.recording.rate])].sort((a, b) => a - b);
        for (const rate of rates)
            element('rate').add(new Option(say('frames_per_second', rate), rate, false, rate === this.viewer.recording.rate));
    }

    listen() {
        const { viewer } = this;
        const { motion } = viewer;
        element('play').onclick = () => viewer.act(() => motion.play(!motion.isPlaying));
        element('fit').onclick = () => viewer.act(() => viewer.fit());
        element('loop').onclick = () => this.setLoop(!motion.loops);
        element('rate').onchange = () => { motion.rate = Number(element('rate').value); };
        element('full').onclick = () => viewer.toggleFullScreen();
        element('more').onclick = () => viewer.act(() => element('sheet').showModal());
        document.addEventListener('fullscreenchange', () => this.nameFullScreen());
        this.slider.oninput = () => viewer.act(() => {
            motion.hold();
            motion.goTo(Number(this.slider.value));
        });
    }

    setLoop(loops) {
        this.viewer.motion.loops = loops;
        element('loop').setAttribute('aria-pressed', loops);
    }

    // A turntable is its own slider: it is turned, not pushed along.
    prepareSlider() {
        const stage = element('stage');
        const { count } = this.viewer.recording;
        if (count < 2) {
            for (const id of ['play', 'loop', 'rate']) element(id).hidden = true;
            return;
        }
        if (this.isTurntable) {
            this.slider = stage;
            stage.tabIndex = 0;
            stage.setAttribute('role', 'slider');
            stage.setAttribute('aria-valuemin', 0);
            stage.setAttribute('aria-valuemax', 360);
            stage.classList.add('turns');
        } else {
            this.slider.max = count - 1;
            this.slider.hidden = false;
            element('clock').hidden = this.viewer.sun !== null;
            element('viewer').classList.add('wide');
        }
        const name = this.isTurntable ? 'turn' : this.viewer.sun ? 'time' : 'position';
        this.slider.setAttribute('aria-label', say(name));
    }

    show(frame) {
        const { recording, motion, picture, sun } = this.viewer;
        label(element('play'), say(motion.isPlaying ? 'pause' : 'play'));
        element('viewer').classList.toggle('playing', motion.isPlaying);
        element('fit').hidden = !picture.isZoomed;
        if (this.isTurntable) {
            this.showAngle(frame);
            return;
        }
        this.slider.value = frame;
        this.slider.style.setProperty('--done', frame / (recording.count - 1));
        this.slider.setAttribute('aria-valuetext', sun?.spoken(frame) ?? say('frame', frame + 1, recording.count));
        element('clock').textContent = `${timeText(frame / motion.rate)} / ${timeText(recording.count / motion.rate)}`;
    }

    // In the sense of the hand: to the right is more.
    showAngle(frame) {
        const { count, turn } = this.viewer.recording;
        const angle = Math.round(360 * ((turn * frame + count) % count) / count);
        this.slider.setAttribute('aria-valuenow', angle);
        this.slider.setAttribute('aria-valuetext', say('degrees', angle));
    }

    showLoading(frames) {
        const ring = element('ring');
        const done = frames.seen.size + frames.broken.size;
        ring.toggleAttribute('hidden', frames.isLoaded || done === 0);
        ring.setAttribute('aria-valuemax', frames.total);
        ring.setAttribute('aria-valuenow', done);
        element('loaded').style.strokeDasharray = `${100 * done / frames.total} 100`;
    }
}

function timeText(seconds) {
    const whole = Math.floor(seconds + 1e-6);
    return `${Math.floor(whole / 60)}:${String(whole % 60).padStart(2, '0')}`;
}

function prepareSheet(recording) {
    const sheet = element('sheet');
    element('embed-line').value = embedLine(recording);
    element('close').onclick = () => sheet.close();
    sheet.addEventListener('click', (event) => { if (event.target === sheet) sheet.close(); });
    element('copy').textContent = say('copy');
    element('copy').onclick = copyLine;
    const steps = recording.kind === 'turntable' ? 'turn' : 'key_step';
    const keys = [['← →', steps], ['Home, End', 'key_ends'], [say('key_space'), 'play'], ['+ −', 'zoom'],
                  ['0', 'fit'], ['F', 'full_screen']];
    for (const [key, text] of keys) {
        const name = document.createElement('kbd');
        name.textContent = key;
        const term = document.createElement('dt');
        term.append(name);
        const meaning = document.createElement('dd');
        meaning.textContent = say(text);
        element('key-list').append(term, meaning);
    }
}

function embedLine({ title, width, height }) {
    const isServed = location.protocol.startsWith('http');
    const address = isServed ? location.href.split('#')[0] : location.pathname.split('/').pop();
    const safe = (text) => text.replace(/&/g, '&amp;').replace(/"/g, '&quot;').replace(/</g, '&lt;');
    return `<iframe src="${safe(address)}" title="${safe(title)}" allow="fullscreen" loading="lazy" ` +
        `style="width: 100%; aspect-ratio: ${width} / ${height}; border: 0"></iframe>`;
}

async function copyLine() {
    const line = element('embed-line');
    line.select();
    try {
        await navigator.clipboard.writeText(line.value);
    } catch {
        document.execCommand('copy'); // pages from disk have no clipboard of their own everywhere
    }
    element('copy').textContent = say('copied');
}
