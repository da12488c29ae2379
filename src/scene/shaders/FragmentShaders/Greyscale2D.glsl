// A patch of a camera's picture: brightness in the colour of the camera.
uniform sampler2D t_Texture;
uniform vec4 u_ModelColour;

varying vec2 v_UV;

void main()
{
	gl_FragColor = vec4(u_ModelColour.rgb * texture2D(t_Texture, v_UV).r, u_ModelColour.a);
}
