// Brings the parts together.

const IDLE_MS = 2600;   // controls fade after this time
const REST_MS = 140;    // a picture that rests so long is drawn finely

class Viewer {
    constructor() {
        const recording = this.recording = RECORDING;
        this.isCalm = matchMedia('(prefers-reduced-motion: reduce)').matches;
        this.wasUsed = false;
        this.picture = new Picture(element('picture'), recording);
        this.frames = new Frames(recording, element('first'), () => this.loadedMore());
        this.motion = new Motion(recording, () => this.draw());
        this.sun = recording.suns ? new Sun(recording.suns, recording.place) : null;
        element('viewer').classList.add(recording.kind);
        this.controls = new Controls(this);
        new Gestures(this);
        element('hint').hidden = recording.kind !== 'turntable' || recording.count < 2;
        this.watch();
        this.frames.fitTo(this.picture.points);
        this.frames.work();
        this.draw();
    }

    watch() {
        new ResizeObserver(() => {
            this.picture.resize();
            this.frames.fitTo(this.picture.wholeWidth * this.picture.ratio);
            this.paint();
        }).observe(element('stage'));
        for (const type of ['pointermove', 'pointerdown', 'keydown', 'focusin'])
            document.addEventListener(type, () => this.wake());
        // The picture that is printed is the page's own, the first.
        addEventListener('beforeprint', () => this.print(true));
        addEventListener('afterprint', () => this.print(false));
    }

    // What a person does: the page is theirs from now on.
    act(action) {
        this.wasUsed = true;
        element('hint').hidden = true;
        this.wake();
        action();
        this.draw();
    }

    // Shows the controls, for a while.
    wake() {
        element('viewer').classList.remove('idle');
        clearTimeout(this.sleep);
        this.sleep = setTimeout(() => this.fade(), IDLE_MS);
    }

    fade() {
        const isBusy = element('controls').matches(':hover') || document.querySelector('#controls :focus-visible');
        if (isBusy || !this.wasUsed && !this.motion.isPlaying) return;
        element('viewer').classList.add('idle');
    }

    // Draws with the next picture of the screen, once.
    draw() {
        this.frames.lookAt(this.motion.frame, this.motion.direction);
        if (this.isDrawing) return;
        this.isDrawing = true;
        requestAnimationFrame(() => {
            this.isDrawing = false;
            this.paint();
        });
    }

    print(isPrinting) {
        this.isPrinting = isPrinting;
        this.paint();
    }

    paint() {
        const wanted = this.motion.frame;
        this.controls.show(wanted);
        this.sun?.show(this.isPrinting ? this.recording.first : wanted);
        const shown = this.frames.nearest(wanted);
        if (shown === null) return;
        const stage = element('stage');
        this.picture.draw(this.frames.bitmap(shown), false);
        stage.classList.add('drawn');
        stage.dataset.frame = wanted;
        stage.dataset.shown = shown;
        clearTimeout(this.rest);
        if (!this.motion.isMoving) this.rest = setTimeout(() => this.paintFinely(shown), REST_MS);
    }

    async paintFinely(frame) {
        const bitmap = this.frames.bitmap(frame);
        if (!bitmap) return;
        const isEnough = bitmap.width >= Math.min(this.picture.points, this.recording.width);
        const fine = isEnough ? bitmap : await this.frames.sharp(frame);
        if (fine && !this.motion.isMoving && Number(element('stage').dataset.shown) === frame)
            this.picture.draw(fine, true);
    }

    fit() {
        this.picture.fit();
        this.zoomed();
    }

    zoomed() {
        element('stage').classList.toggle('zoomed', this.picture.isZoomed);
        this.draw();
    }

    toggleFullScreen() {
        if (document.fullscreenElement) document.exitFullscreen();
        else element('viewer').requestFullscreen?.();
    }

    loadedMore() {
        this.controls.showLoading(this.frames);
        const { frames, motion } = this;
        const shown = Number(element('stage').dataset.shown ?? -1);
        if (frames.nearest(motion.frame) !== shown) this.draw();
        if (!frames.isLoaded) return;
        element('stage').dataset.loaded = 'all';
        this.tellBroken();
        if (this.wasUsed || this.isCalm || this.hasBegun) return;
        this.hasBegun = true;
        motion.play(true);
        this.wake();
    }

    tellBroken() {
        const { broken, total } = this.frames;
        const note = element('note');
        if (broken.size === 0) return;
        note.textContent = say(broken.size === total ? 'none_loaded' : 'some_not_loaded', broken.size, total);
        note.classList.toggle('small', broken.size < total);
    }
}

showTexts();
new Viewer();
